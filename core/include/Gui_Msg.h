// Gui_Msg: a localised message from a string table.
//
//     CString text = (Gui_Msg(20801) << currentPage).GetValue();
//
// The text is string id of the given module, or, without a module, of the
// first module that Gui_Locale registered that has it. In the text, %1 ... %n
// (n up to 99: the one or two digits after the '%') are replaced by the
// arguments given with <<, in decimal, %1 by the first; "%%" gives "%"; a '%'
// followed by anything else, or by a number with no argument, is kept as it
// is. The text is never handed to a printf-style formatter, so any text is
// safe. A string that no module has gives the empty text.
#pragma once

#include "Tavo_CoreApi.h"

#include <afx.h>

#include <string>
#include <vector>

class TAVO_CORE_API Gui_Msg {
public:
    explicit Gui_Msg(unsigned int id, HINSTANCE module = nullptr);

    Gui_Msg& operator<<(int argument);

    CString GetValue() const;
    unsigned int GetId() const { return m_id; }

    // The text of string id (see above), without replacements; false when no
    // module has it.
    static bool LoadText(unsigned int id, HINSTANCE module, std::string& text);
    // Replaces %1 ... %n in text by arguments as described above.
    static std::string Substitute(const std::string& text, const std::vector<std::string>& arguments);

private:
    unsigned int m_id;
    HINSTANCE m_module; // not owned
    std::vector<std::string> m_arguments;
};
