#pragma once

#include "base/memory.h"

#include <cstddef>

namespace tension
{

// The program's shared text string: heap bytes in code page 932 with a
// terminating zero and a byte length. The tension file keeps its name and
// comment in it, and the message log of a check is one.
//
// Appending grows the block by doubling: a log of a message per entry must
// not cost time in the square of its length (a long text picked as a tension
// file by mistake, a program's source say, logs a message for each of its
// tens of thousands of ";"-ended pieces).
class CTextString : public base::CAllocated
{
public:
    CTextString() = default;
    explicit CTextString(const char* text);
    CTextString(const CTextString& other);
    CTextString& operator=(const CTextString& other);
    ~CTextString();

    // Each keeps the old text and returns false when the block cannot be had.
    bool Assign(const char* text);
    bool Assign(const char* text, std::size_t length);
    bool Append(const char* text);
    bool Append(const char* text, std::size_t length);

    // Bytes before the terminating zero.
    std::size_t Length() const { return length_; }
    // Never null: an empty string answers "".
    const char* CStr() const { return data_ != nullptr ? data_ : ""; }

private:
    char* data_ = nullptr;
    std::size_t length_ = 0;
    // Bytes the block holds before its terminating zero.
    std::size_t capacity_ = 0;
};

} // namespace tension
