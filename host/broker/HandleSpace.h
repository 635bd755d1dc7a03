/// \file
/// Where the handles of all brokers of the process live: one stretch of address space, so that
/// whether a pointer is a handle at all is a comparison of addresses.
#ifndef CIMHOST_BROKER_HANDLESPACE_H
#define CIMHOST_BROKER_HANDLESPACE_H

#include "broker/Handle.h"

#include <atomic>
#include <cstddef>
#include <mutex>

namespace cimhost {

/// Handles are taken and given back in blocks. A block given back is quarantined: it is not taken
/// again before `quarantinedBlocks` others have been given back after it. So a provider's pointer to
/// a dead object is recognised as such for that long at least; after it, the pointer may lead to a
/// younger object. Safe to use from several threads.
class HandleSpace
{
public:
    static constexpr std::size_t blockSize = 64;
    static constexpr std::size_t quarantinedBlocks = 4096;

    /// The one of the process; never destroyed, since threads may end after everything else.
    static HandleSpace& instance();

    HandleSpace(const HandleSpace&) = delete;
    HandleSpace& operator=(const HandleSpace&) = delete;

    /// The first of `blockSize` handles, none of them live.
    /// \throws std::bad_alloc
    Handle* takeBlock();
    /// \param block  from takeBlock, with no live handle in it
    void giveBack(Handle* block) noexcept;

    /// The handle at an address; null when no handle ever stood there. Follows no pointer.
    Handle* find(const void* address) const noexcept;

private:
    HandleSpace();
    ~HandleSpace() = default;

    Handle* base_ = nullptr;
    std::size_t capacity_ = 0;         ///< in blocks
    std::atomic<std::size_t> used_{0}; ///< blocks that were taken at least once
    std::mutex mutex_;                 ///< guards the members below, and growing `used_`
    // The quarantine: first in, first out, linked through the payload of each block's first handle.
    Handle* oldest_ = nullptr;
    Handle* youngest_ = nullptr;
    std::size_t quarantined_ = 0;
};

} // namespace cimhost

#endif
