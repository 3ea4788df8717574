// Port_Env: reads the platform's environment block.
#include "Port_Env.h"

#include <windows.h>

#include <map>
#include <string>

const char* Port_Env::GetEnv(const char* name)
{
    if (!name || !*name)
        return nullptr;
    // One value per name and thread, so that a pointer handed out stays valid
    // while other names are read.
    thread_local std::map<std::string, std::string> values;

    std::string value(64, '\0');
    for (;;) {
        SetLastError(ERROR_SUCCESS);
        const DWORD length = GetEnvironmentVariableA(name, &value[0], static_cast<DWORD>(value.size()));
        if (length == 0) {
            if (GetLastError() == ERROR_ENVVAR_NOT_FOUND)
                return nullptr;
            value.clear(); // set, but empty
            break;
        }
        if (length < value.size()) {
            value.resize(length);
            break;
        }
        value.resize(length); // too small: length is the size needed, with the terminator
    }
    std::string& kept = values[name];
    kept = value;
    return kept.c_str();
}
