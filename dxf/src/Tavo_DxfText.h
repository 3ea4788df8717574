// Text of DXF entities as plain text for the core.
//
// TEXT values may hold control codes (%%d degree, %%p plus-minus, %%c
// diameter, %%% percent, %%u and %%o underline and overline switches, %%nnn a
// character code) and \U+XXXX escapes. MTEXT adds its formatting: \P breaks a
// paragraph, \~ is a hard space, \\ \{ \} are the characters themselves,
// { } group, \S stacks a fraction (shown as a/b), and codes such as \f...; \H...;
// \C...; or \L change fonts and looks: they are removed.
//
// The result is in Windows-1252, which the rendering surface's text calls
// use; other characters become '?', control characters spaces.
#pragma once

#include <string>
#include <string_view>
#include <vector>

// Plain text of a TEXT value. utf8: the file's strings are UTF-8 (else they are
// taken as Windows-1252).
std::string Tavo_DxfPlainText(std::string_view raw, bool utf8);

// Plain lines of an MTEXT value, one per paragraph.
std::vector<std::string> Tavo_DxfPlainMText(std::string_view raw, bool utf8);
