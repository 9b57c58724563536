#pragma once

#include "base/memory.h"
#include "tension/text_string.h"

#include <cstdint>

namespace tension
{

// One key of a timeline: three 32-bit fields in this order.
struct KeyFrame
{
    float time;
    float ease;
    std::int32_t value;
};
static_assert(sizeof(KeyFrame) == 12);

// A named timeline of keys holding one 32-bit value each, kept in ascending
// order of time and evaluated as a step function: the value at a time is the
// value of the last key at or before it.
class CKeyFrameList : public base::CAllocated
{
public:
    // Two keys closer than this (single precision, seconds) cannot coexist.
    static constexpr float kMinimumKeyDistance = 0.006f;

    explicit CKeyFrameList(const char* name = "");
    CKeyFrameList(const CKeyFrameList& other);
    CKeyFrameList& operator=(const CKeyFrameList&) = delete;

    virtual ~CKeyFrameList();
    virtual bool Release();
    virtual const char* GetClassName() const;
    virtual std::uint32_t GetClassSize() const;
    virtual CKeyFrameList* CreateAt(void* memory) const;
    virtual CKeyFrameList* Create() const;
    virtual CKeyFrameList* CloneAt(void* memory) const;
    virtual CKeyFrameList* Clone() const;

    // Refuses (false) a time within kMinimumKeyDistance of an existing key's
    // time, a time that is not a number, and a failed allocation; otherwise
    // appends the key and re-sorts the list by ascending time.
    bool KeyAdd(std::int32_t value, float time, float ease);

    std::uint32_t GetKeyCount() const { return count_; }
    // Null past the end.
    const KeyFrame* GetKey(std::uint32_t index) const;
    const char* GetName() const { return name_.CStr(); }

    // The value of the last key whose time is at or before `time`; false
    // when there is none (an empty list, or a time before the first key).
    bool Evaluate(float time, std::int32_t* value) const;

private:
    CTextString name_;
    KeyFrame* keys_ = nullptr;
    std::uint32_t count_ = 0;
};

} // namespace tension
