#pragma once

#include "base/memory.h"

#include <cstdint>

namespace sound
{

// Base of the loadable resources of the in-house library: a heap copy of
// the resource's name, the name's size in bytes with its NUL, and a type tag.
// The virtual operations are declared in slot order; the loading entry points
// (slots 1 to 8) are forwarders and stubs that the tool never calls.
class CResourceBase : public base::CAllocated
{
public:
    CResourceBase() = default;
    CResourceBase(const CResourceBase& other);
    CResourceBase& operator=(const CResourceBase&) = delete;

    virtual ~CResourceBase();
    // Forwards to LoadFromFile.
    virtual bool Load(const char* path);
    // Stub: false. A resource class that can load itself overrides it.
    virtual bool LoadFromFile(const char* path);
    // Stub: false.
    virtual bool LoadFromMemory(const void* data, std::uint32_t size);
    // Forwards to LoadFromFile with the resource's name; false without one.
    virtual bool Reload();
    // Forwards to Release.
    virtual bool Unload();
    // Stub: false. Overridden by resources that know.
    virtual bool IsLoaded() const;
    // Stub: 0. Overridden by resources that know.
    virtual std::uint32_t GetResourceSize() const;
    // Copies the class name into `buffer` (cut to `size` - 1 bytes, always
    // terminated when `size` is not 0).
    virtual void CopyClassName(char* buffer, std::uint32_t size) const;
    virtual const char* GetClassName() const;
    virtual std::uint32_t GetClassSize() const;
    virtual CResourceBase* CreateAt(void* memory) const;
    virtual CResourceBase* Create() const;
    virtual CResourceBase* CloneAt(void* memory) const;
    virtual CResourceBase* Clone() const;
    // Frees the name.
    virtual bool Release();
    // A heap copy of `name` (null frees the name); false when it cannot be had.
    virtual bool SetName(const char* name);
    // An empty, zero-filled name of `size` bytes.
    virtual bool ReserveName(std::uint32_t size);
    // "" when there is none.
    virtual const char* GetName() const;
    virtual std::uint32_t GetNameSize() const;
    virtual std::uint32_t GetType() const;

protected:
    void SetType(std::uint32_t type) { type_ = type; }
    void FreeName();

private:
    char* name_ = nullptr;
    std::uint32_t nameSize_ = 0;
    std::uint32_t type_ = 0;
};

} // namespace sound
