#include "tension/key_frame_list.h"

#include <cmath>
#include <cstring>
#include <new>

namespace tension
{

CKeyFrameList::CKeyFrameList(const char* name) : name_(name) {}

CKeyFrameList::CKeyFrameList(const CKeyFrameList& other) : name_(other.name_)
{
    if (other.count_ == 0)
        return;
    keys_ = static_cast<KeyFrame*>(base::AllocateZeroed(other.count_ * sizeof(KeyFrame)));
    if (keys_ == nullptr)
        return;
    std::memcpy(keys_, other.keys_, other.count_ * sizeof(KeyFrame));
    count_ = other.count_;
}

CKeyFrameList::~CKeyFrameList()
{
    Release();
}

bool CKeyFrameList::Release()
{
    base::FreeBlock(keys_);
    keys_ = nullptr;
    count_ = 0;
    return true;
}

const char* CKeyFrameList::GetClassName() const
{
    return "CKeyFrameList";
}

std::uint32_t CKeyFrameList::GetClassSize() const
{
    return sizeof(CKeyFrameList);
}

CKeyFrameList* CKeyFrameList::CreateAt(void* memory) const
{
    return new (memory) CKeyFrameList();
}

CKeyFrameList* CKeyFrameList::Create() const
{
    return new (std::nothrow) CKeyFrameList();
}

CKeyFrameList* CKeyFrameList::CloneAt(void* memory) const
{
    return new (memory) CKeyFrameList(*this);
}

CKeyFrameList* CKeyFrameList::Clone() const
{
    return new (std::nothrow) CKeyFrameList(*this);
}

bool CKeyFrameList::KeyAdd(std::int32_t value, float time, float ease)
{
    if (std::isnan(time))
        return false;
    for (std::uint32_t i = 0; i < count_; ++i)
    {
        const float existing = keys_[i].time;
        if (time >= existing - kMinimumKeyDistance && time <= existing + kMinimumKeyDistance)
            return false;
    }
    // Variable-length arrays are reallocated to their exact new length.
    auto* grown = static_cast<KeyFrame*>(base::AllocateZeroed((count_ + 1) * sizeof(KeyFrame)));
    if (grown == nullptr)
        return false;
    if (count_ != 0)
        std::memcpy(grown, keys_, count_ * sizeof(KeyFrame));
    grown[count_] = KeyFrame{time, ease, value};
    base::FreeBlock(keys_);
    keys_ = grown;
    ++count_;
    // The list was sorted before: the new key only has to sink to its place.
    for (std::uint32_t i = count_ - 1; i > 0 && keys_[i - 1].time > keys_[i].time; --i)
    {
        const KeyFrame moved = keys_[i];
        keys_[i] = keys_[i - 1];
        keys_[i - 1] = moved;
    }
    return true;
}

const KeyFrame* CKeyFrameList::GetKey(std::uint32_t index) const
{
    return index < count_ ? &keys_[index] : nullptr;
}

bool CKeyFrameList::Evaluate(float time, std::int32_t* value) const
{
    const KeyFrame* found = nullptr;
    for (std::uint32_t i = 0; i < count_ && keys_[i].time <= time; ++i)
        found = &keys_[i];
    if (found == nullptr)
        return false;
    *value = found->value;
    return true;
}

} // namespace tension
