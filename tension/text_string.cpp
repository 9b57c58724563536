#include "tension/text_string.h"

#include <cstring>

namespace tension
{

CTextString::CTextString(const char* text)
{
    Assign(text);
}

CTextString::CTextString(const CTextString& other)
{
    Assign(other.CStr(), other.Length());
}

CTextString& CTextString::operator=(const CTextString& other)
{
    if (this != &other)
        Assign(other.CStr(), other.Length());
    return *this;
}

CTextString::~CTextString()
{
    base::FreeBlock(data_);
}

bool CTextString::Assign(const char* text)
{
    return Assign(text, text != nullptr ? std::strlen(text) : 0);
}

bool CTextString::Assign(const char* text, std::size_t length)
{
    // The block is zero-filled, so the copy is terminated already.
    char* block = static_cast<char*>(base::AllocateZeroed(length + 1));
    if (block == nullptr)
        return false;
    if (length != 0)
        std::memcpy(block, text, length);
    base::FreeBlock(data_);
    data_ = block;
    length_ = length;
    capacity_ = length;
    return true;
}

bool CTextString::Append(const char* text)
{
    return Append(text, text != nullptr ? std::strlen(text) : 0);
}

bool CTextString::Append(const char* text, std::size_t length)
{
    const std::size_t needed = length_ + length;
    if (needed > capacity_)
    {
        const std::size_t capacity = needed > 2 * capacity_ ? needed : 2 * capacity_;
        char* block = static_cast<char*>(base::AllocateZeroed(capacity + 1));
        if (block == nullptr)
            return false;
        if (length_ != 0)
            std::memcpy(block, data_, length_);
        // `text` may lie in the old block: it is freed only after the copy.
        if (length != 0)
            std::memcpy(block + length_, text, length);
        base::FreeBlock(data_);
        data_ = block;
        capacity_ = capacity;
    }
    else if (length != 0)
    {
        std::memmove(data_ + length_, text, length);
    }
    length_ = needed;
    if (data_ != nullptr)
        data_[length_] = '\0';
    return true;
}

} // namespace tension
