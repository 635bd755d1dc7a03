/// \file
/// The objects that end together: those of one request, or of a broker.
#ifndef CIMHOST_BROKER_OBJECTSTORE_H
#define CIMHOST_BROKER_OBJECTSTORE_H

#include "broker/Core.h"
#include "broker/HandleSpace.h"
#include "broker/Objects.h"

#include <cstddef>
#include <memory>
#include <unordered_map>
#include <utility>
#include <vector>

namespace cimhost {

/// Not safe to use from several threads at once.
class ObjectStore
{
public:
    explicit ObjectStore(Core& core) : core_(core) {}
    /// Ends every object that is still alive.
    ~ObjectStore();
    ObjectStore(const ObjectStore&) = delete;
    ObjectStore& operator=(const ObjectStore&) = delete;

    /// A new object with that content.
    /// \throws std::bad_alloc  when memory or handles are used up
    template <class Object>
    Handle& add(std::unique_ptr<Object> content);

    /// How many objects were made so far: the place that a mark remembers.
    [[nodiscard]] std::size_t count() const { return blocks_.size() * HandleSpace::blockSize - free_; }
    /// Releases every object made since `count()` was `ordinal`.
    void releaseFrom(std::size_t ordinal) noexcept;

    /// A block of memory that is freed with the store.
    void addMemory(std::unique_ptr<MemoryObject> memory);
    /// The live handle of such a block; null when there is none.
    Handle* findMemory(void* block) const;

private:
    Handle& next();
    [[nodiscard]] Handle& at(std::size_t ordinal) const;

    Core& core_;
    std::vector<Handle*> blocks_;
    std::size_t free_ = 0;                      ///< handles of the last block that were not taken yet
    std::unordered_map<void*, Handle*> memory_; ///< entries stay when their block is released
};

template <class Object>
Handle& ObjectStore::add(std::unique_ptr<Object> content)
{
    Handle& handle = next();
    handle.core = &core_;
    handle.kind = Traits<Object>::kind;
    if constexpr (Traits<Object>::hasTable)
        handle.envelope.*(Traits<Object>::envelope) = {&handle, &(core_.tables.*(Traits<Object>::table))};
    else
        handle.envelope.string = {&handle, nullptr};
    handle.payload = content.release();
    handle.state.store(State::live, std::memory_order_release);
    return handle;
}

} // namespace cimhost

#endif
