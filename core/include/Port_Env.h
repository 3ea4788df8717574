// Port_Env: the process environment, as the platform holds it (variables set
// with SetEnvironmentVariable and with _putenv are both seen).
#pragma once

#include "Tavo_CoreApi.h"

class TAVO_CORE_API Port_Env {
public:
    // The value of the variable as an 8-bit string, or null when it is not set
    // (or name is null or empty). The text stays valid until GetEnv is asked for
    // the same name again on the same thread.
    static const char* GetEnv(const char* name);
};
