#include "sound/resource_base.h"

#include <cstring>
#include <new>

namespace sound
{

CResourceBase::CResourceBase(const CResourceBase& other) : type_(other.type_)
{
    if (other.name_ != nullptr && ReserveName(other.nameSize_))
        std::memcpy(name_, other.name_, other.nameSize_);
}

CResourceBase::~CResourceBase()
{
    FreeName();
}

bool CResourceBase::Load(const char* path)
{
    return LoadFromFile(path);
}

bool CResourceBase::LoadFromFile(const char*)
{
    return false;
}

bool CResourceBase::LoadFromMemory(const void*, std::uint32_t)
{
    return false;
}

bool CResourceBase::Reload()
{
    if (name_ == nullptr)
        return false;
    // LoadFromFile may set the name again: load from a copy.
    CResourceBase saved(*this);
    return LoadFromFile(saved.name_);
}

bool CResourceBase::Unload()
{
    return Release();
}

bool CResourceBase::IsLoaded() const
{
    return false;
}

std::uint32_t CResourceBase::GetResourceSize() const
{
    return 0;
}

void CResourceBase::CopyClassName(char* buffer, std::uint32_t size) const
{
    if (buffer == nullptr || size == 0)
        return;
    const char* name = GetClassName();
    const std::size_t length = std::strlen(name) < size ? std::strlen(name) : size - 1;
    std::memcpy(buffer, name, length);
    buffer[length] = '\0';
}

const char* CResourceBase::GetClassName() const
{
    return "CResourceBase";
}

std::uint32_t CResourceBase::GetClassSize() const
{
    return sizeof(CResourceBase);
}

CResourceBase* CResourceBase::CreateAt(void* memory) const
{
    return new (memory) CResourceBase();
}

CResourceBase* CResourceBase::Create() const
{
    return new (std::nothrow) CResourceBase();
}

CResourceBase* CResourceBase::CloneAt(void* memory) const
{
    return new (memory) CResourceBase(*this);
}

CResourceBase* CResourceBase::Clone() const
{
    return new (std::nothrow) CResourceBase(*this);
}

bool CResourceBase::Release()
{
    FreeName();
    return true;
}

bool CResourceBase::SetName(const char* name)
{
    if (name == nullptr)
    {
        FreeName();
        return true;
    }
    // Copied before the old name goes: `name` may be the name itself.
    const auto size = static_cast<std::uint32_t>(std::strlen(name) + 1);
    auto* block = static_cast<char*>(base::AllocateZeroed(size));
    if (block == nullptr)
        return false;
    std::memcpy(block, name, size);
    FreeName();
    name_ = block;
    nameSize_ = size;
    return true;
}

bool CResourceBase::ReserveName(std::uint32_t size)
{
    auto* block = static_cast<char*>(base::AllocateZeroed(size));
    if (block == nullptr)
        return false;
    FreeName();
    name_ = block;
    nameSize_ = size;
    return true;
}

const char* CResourceBase::GetName() const
{
    return name_ != nullptr ? name_ : "";
}

std::uint32_t CResourceBase::GetNameSize() const
{
    return nameSize_;
}

std::uint32_t CResourceBase::GetType() const
{
    return type_;
}

void CResourceBase::FreeName()
{
    base::FreeBlock(name_);
    name_ = nullptr;
    nameSize_ = 0;
}

} // namespace sound
