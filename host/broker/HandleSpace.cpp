#include "broker/HandleSpace.h"

#include <cstdint>
#include <functional>
#include <new>

#include <sys/mman.h>

namespace cimhost {

namespace {

constexpr std::size_t bytesPerBlock = HandleSpace::blockSize * sizeof(Handle);
/// Address space only; memory is used as blocks are. Less is taken where a limit forbids this much.
constexpr std::size_t mostBytes = std::size_t{4} << 30U;
constexpr std::size_t leastBytes = std::size_t{1} << 20U;

void* reserve(std::size_t bytes)
{
    void* const memory =
        mmap(nullptr, bytes, PROT_READ | PROT_WRITE, MAP_PRIVATE | MAP_ANONYMOUS | MAP_NORESERVE, -1, 0);
    return memory == MAP_FAILED ? nullptr : memory;
}

} // namespace

HandleSpace& HandleSpace::instance()
{
    static HandleSpace& space = *new HandleSpace;
    return space;
}

HandleSpace::HandleSpace()
{
    for (std::size_t bytes = mostBytes; bytes >= leastBytes && base_ == nullptr; bytes /= 2) {
        base_ = static_cast<Handle*>(reserve(bytes));
        capacity_ = bytes / bytesPerBlock;
    }
    if (base_ == nullptr)
        throw std::bad_alloc();
}

Handle* HandleSpace::takeBlock()
{
    const std::lock_guard<std::mutex> lock(mutex_);
    const std::size_t used = used_.load(std::memory_order_relaxed);
    const bool full = used == capacity_;
    if (quarantined_ > quarantinedBlocks || (full && oldest_ != nullptr)) {
        Handle* const block = oldest_;
        oldest_ = static_cast<Handle*>(block->payload);
        if (oldest_ == nullptr)
            youngest_ = nullptr;
        --quarantined_;
        block->payload = nullptr;
        return block;
    }
    if (full)
        throw std::bad_alloc();
    Handle* const block = base_ + used * blockSize;
    for (std::size_t i = 0; i < blockSize; ++i)
        new (block + i) Handle;
    used_.store(used + 1, std::memory_order_release);
    return block;
}

void HandleSpace::giveBack(Handle* block) noexcept
{
    const std::lock_guard<std::mutex> lock(mutex_);
    block->payload = nullptr;
    if (youngest_ == nullptr)
        oldest_ = block;
    else
        youngest_->payload = block;
    youngest_ = block;
    ++quarantined_;
}

Handle* HandleSpace::find(const void* address) const noexcept
{
    const auto start = reinterpret_cast<std::uintptr_t>(base_);
    const auto place = reinterpret_cast<std::uintptr_t>(address);
    const std::size_t handles = used_.load(std::memory_order_acquire) * blockSize;
    if (place < start || place >= start + handles * sizeof(Handle) || (place - start) % sizeof(Handle) != 0)
        return nullptr;
    return base_ + (place - start) / sizeof(Handle);
}

} // namespace cimhost
