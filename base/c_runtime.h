#pragma once

// How the Windows C runtime reads text files and numbers. The game reads
// tension files through it, so every build of ours reads them its way rather
// than trusting its own C library, whose text mode and atof differ.

#include <cstddef>

namespace base
{

// Turns the bytes of a file into what a read in text mode gives: a CR LF pair
// becomes one line feed, a lone CR stays, and a Ctrl-Z ends the text. Works in
// place and returns the new length.
std::size_t TranslateTextMode(char* bytes, std::size_t size);

// What atoi reads: white space, a sign and the leading decimal digits; 0 when
// there are none. A number beyond the int range saturates, as in the Windows
// runtime, where glibc's would wrap.
int ReadLeadingInteger(const char* text);

// What atof reads: white space, a sign, decimal digits with an optional
// fraction, and an exponent led by e, E, d or D; 0 when no number leads the
// text. Hexadecimal, infinity and NaN spellings are not numbers there.
double ReadDecimal(const char* text);

} // namespace base
