#include "base/c_runtime.h"

#include <charconv>
#include <climits>
#include <cmath>
#include <string>

namespace base
{
namespace
{

constexpr char kEndOfText = 0x1A;

bool IsDigit(char c)
{
    return c >= '0' && c <= '9';
}

bool IsSpace(char c)
{
    return c == ' ' || (c >= '\t' && c <= '\r');
}

// Passes the white space and the sign that lead a number; true for a minus.
bool SkipSpaceAndSign(const char*& text)
{
    while (IsSpace(*text))
        ++text;
    const bool negative = *text == '-';
    if (*text == '-' || *text == '+')
        ++text;
    return negative;
}

} // namespace

std::size_t TranslateTextMode(char* bytes, std::size_t size)
{
    std::size_t kept = 0;
    for (std::size_t i = 0; i < size && bytes[i] != kEndOfText; ++i)
    {
        if (bytes[i] == '\r' && i + 1 < size && bytes[i + 1] == '\n')
            ++i;
        bytes[kept++] = bytes[i];
    }
    return kept;
}

int ReadLeadingInteger(const char* text)
{
    const bool negative = SkipSpaceAndSign(text);
    // Counted towards the negative end, which holds one more value.
    long long value = 0;
    for (; IsDigit(*text); ++text)
    {
        value = value * 10 - (*text - '0');
        if (value < INT_MIN)
            return negative ? INT_MIN : INT_MAX;
    }
    if (!negative)
        return value < -INT_MAX ? INT_MAX : static_cast<int>(-value);
    return static_cast<int>(value);
}

double ReadDecimal(const char* text)
{
    const bool negative = SkipSpaceAndSign(text);

    // The number is rewritten in the one form from_chars takes, which reads
    // the same on every platform and in every locale. The power of ten of its
    // leading digit decides, when it is out of range, between infinity and 0.
    std::string number;
    std::size_t digits = 0;
    long leadingPower = 0;
    bool significant = false;
    for (; IsDigit(*text); ++text, ++digits)
    {
        number += *text;
        significant = significant || *text != '0';
        leadingPower += significant ? 1 : 0;
    }
    if (*text == '.')
    {
        number += *text++;
        for (; IsDigit(*text); ++text, ++digits)
        {
            number += *text;
            leadingPower -= significant ? 0 : 1;
            significant = significant || *text != '0';
        }
    }
    if (digits == 0)
        return 0.0;

    // The exponent counts only when a digit follows its letter and sign.
    const bool exponentLetter = *text == 'e' || *text == 'E' || *text == 'd' || *text == 'D';
    const char* exponent = exponentLetter ? text + 1 : text;
    const bool exponentNegative = exponentLetter && *exponent == '-';
    if (exponentLetter && (*exponent == '-' || *exponent == '+'))
        ++exponent;
    if (exponentLetter && IsDigit(*exponent))
    {
        number += exponentNegative ? "e-" : "e";
        long power = 0;
        for (; IsDigit(*exponent); ++exponent)
        {
            number += *exponent;
            power = power < 100000 ? power * 10 + (*exponent - '0') : power;
        }
        leadingPower += exponentNegative ? -power : power;
    }

    double value = 0.0;
    if (std::from_chars(number.data(), number.data() + number.size(), value).ec ==
        std::errc::result_out_of_range)
        value = leadingPower > 0 ? HUGE_VAL : 0.0;
    return negative ? -value : value;
}

} // namespace base
