#pragma once

#include <cstddef>
#include <cstdint>
#include <cstdio>

namespace sound
{

// Random access to the bytes of a file or of a block in memory.
class ByteSource
{
public:
    virtual ~ByteSource() = default;
    virtual std::uint64_t Size() const = 0;
    // Exactly `size` bytes from `offset`; false when fewer are there.
    virtual bool ReadAt(std::uint64_t offset, void* buffer, std::size_t size) = 0;
};

// A block owned by the caller.
class MemorySource : public ByteSource
{
public:
    MemorySource(const void* data, std::size_t size)
        : data_(static_cast<const std::uint8_t*>(data)), size_(size)
    {
    }
    std::uint64_t Size() const override { return size_; }
    bool ReadAt(std::uint64_t offset, void* buffer, std::size_t size) override;

private:
    const std::uint8_t* data_;
    std::size_t size_;
};

// A file opened for binary reading; closed with the object.
class FileSource : public ByteSource
{
public:
    FileSource() = default;
    FileSource(const FileSource&) = delete;
    FileSource& operator=(const FileSource&) = delete;
    ~FileSource() override;

    // False when the file cannot be opened or its size cannot be learnt.
    bool Open(const char* path);
    std::uint64_t Size() const override { return size_; }
    bool ReadAt(std::uint64_t offset, void* buffer, std::size_t size) override;

private:
    std::FILE* file_ = nullptr;
    std::uint64_t size_ = 0;
};

} // namespace sound
