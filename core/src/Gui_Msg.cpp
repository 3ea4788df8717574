// Gui_Msg: string-table lookup and argument replacement.
#include "Gui_Msg.h"

#include "Gui_ResourceModules.h"

namespace {

// Reads string id from the module's string table. Strings are kept in blocks
// of 16 (block id / 16 + 1), each as a 16-bit length and that many UTF-16
// units; an absent string has length 0 and counts as missing.
bool ReadString(HINSTANCE module, unsigned int id, std::string& text)
{
    if (!module || id > 0xFFFF)
        return false;
    HRSRC found = FindResourceA(module, MAKEINTRESOURCEA(id / 16 + 1), MAKEINTRESOURCEA(6) /* RT_STRING */);
    if (!found)
        return false;
    HGLOBAL loaded = LoadResource(module, found);
    const WCHAR* block = loaded ? static_cast<const WCHAR*>(LockResource(loaded)) : nullptr;
    if (!block)
        return false;
    const DWORD size = SizeofResource(module, found) / sizeof(WCHAR);
    DWORD at = 0;
    for (unsigned int skip = id % 16; skip > 0; --skip) {
        if (at >= size)
            return false;
        at += 1 + block[at];
    }
    if (at >= size || block[at] == 0 || at + 1 + block[at] > size)
        return false;
    const int length = block[at];
    const WCHAR* wide = block + at + 1;
    const int bytes = WideCharToMultiByte(CP_ACP, 0, wide, length, nullptr, 0, nullptr, nullptr);
    text.assign(static_cast<size_t>(bytes), '\0');
    if (bytes > 0)
        WideCharToMultiByte(CP_ACP, 0, wide, length, &text[0], bytes, nullptr, nullptr);
    return true;
}

} // namespace

Gui_Msg::Gui_Msg(unsigned int id, HINSTANCE module) : m_id(id), m_module(module) {}

Gui_Msg& Gui_Msg::operator<<(int argument)
{
    m_arguments.push_back(std::to_string(argument));
    return *this;
}

CString Gui_Msg::GetValue() const
{
    std::string text;
    if (!LoadText(m_id, m_module, text))
        return CString();
    const std::string value = Substitute(text, m_arguments);
    return CString(value.c_str(), static_cast<int>(value.size()));
}

bool Gui_Msg::LoadText(unsigned int id, HINSTANCE module, std::string& text)
{
    if (module)
        return ReadString(module, id, text);
    for (HINSTANCE registered : Gui_ResourceModules()) {
        if (ReadString(registered, id, text))
            return true;
    }
    return false;
}

std::string Gui_Msg::Substitute(const std::string& text, const std::vector<std::string>& arguments)
{
    std::string out;
    out.reserve(text.size());
    for (size_t i = 0; i < text.size(); ++i) {
        const char c = text[i];
        if (c != '%' || i + 1 >= text.size()) {
            out += c;
            continue;
        }
        const char next = text[i + 1];
        if (next == '%') {
            out += '%';
            ++i;
            continue;
        }
        if (next < '1' || next > '9') {
            out += c;
            continue;
        }
        // One or two digits name the argument.
        size_t digits = 1;
        int number = next - '0';
        if (i + 2 < text.size() && text[i + 2] >= '0' && text[i + 2] <= '9') {
            number = number * 10 + (text[i + 2] - '0');
            digits = 2;
        }
        if (number > static_cast<int>(arguments.size())) {
            out += c; // no such argument: keep the text
            continue;
        }
        out += arguments[number - 1];
        i += digits;
    }
    return out;
}
