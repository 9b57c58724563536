#pragma once

// vekcfg puts every text together in UTF-8 and converts once, at the edges:
// from code page 932 (the tool's own texts, the check's messages, the strings
// of the settings file), from the command line's own encoding (paths as
// given), and to the console when printing.

#include <cstdio>
#include <string>
#include <string_view>

namespace cli
{

// A byte sequence that code page 932 does not map becomes U+FFFD, one per
// character, so that a damaged string never swallows what follows it.
std::string Utf8FromCp932(std::string_view text);

// A path as the command line gave it: UTF-8 on Linux, the ANSI code page on
// Windows.
std::string Utf8FromNative(std::string_view text);

// A path given in UTF-8 as the system's functions open it: as it is on
// Linux, in the ANSI code page on Windows. False when that code page has no
// form for one of its characters: nothing is replaced by a near match.
bool NativeFromUtf8(std::string_view utf8, std::string* native);

// A text given in UTF-8 as the tool's code page stores it. False when the
// text is not UTF-8 or a character has no code page 932 form: nothing is
// replaced by a near match.
bool Cp932FromUtf8(std::string_view utf8, std::string* cp932);

// Prints UTF-8 text as the platform's console shows it: UTF-8 on Linux, the
// console's code page on Windows. False when it could not all be written.
bool WriteConsoleText(std::FILE* stream, std::string_view utf8);

// The number of bytes of the code page 932 character at the start of
// `text`: 2 for a lead byte followed by a trail byte, else 1 (0 when empty).
std::size_t Cp932CharacterSize(std::string_view text);

} // namespace cli
