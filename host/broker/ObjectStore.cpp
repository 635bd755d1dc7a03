#include "broker/ObjectStore.h"

namespace cimhost {

ObjectStore::~ObjectStore()
{
    for (std::size_t ordinal = 0; ordinal < count(); ++ordinal)
        end(at(ordinal), State::ended);
    // A block that is given back may be taken by another thread at once.
    for (Handle* const block : blocks_)
        HandleSpace::instance().giveBack(block);
}

void ObjectStore::releaseFrom(std::size_t ordinal) noexcept
{
    for (; ordinal < count(); ++ordinal)
        end(at(ordinal), State::released);
}

void ObjectStore::addMemory(std::unique_ptr<MemoryObject> memory)
{
    Handle*& handle = memory_[memory->block]; // first, since it may throw
    handle = nullptr;
    handle = &add(std::move(memory));
}

Handle* ObjectStore::findMemory(void* block) const
{
    const auto found = memory_.find(block);
    if (found == memory_.end() || found->second == nullptr)
        return nullptr;
    Handle* const handle = found->second;
    return handle->state.load(std::memory_order_acquire) == State::live ? handle : nullptr;
}

Handle& ObjectStore::next()
{
    if (free_ == 0) {
        blocks_.reserve(blocks_.size() + 1);
        blocks_.push_back(HandleSpace::instance().takeBlock());
        free_ = HandleSpace::blockSize;
    }
    Handle& handle = at(count());
    --free_;
    return handle;
}

Handle& ObjectStore::at(std::size_t ordinal) const
{
    return blocks_[ordinal / HandleSpace::blockSize][ordinal % HandleSpace::blockSize];
}

} // namespace cimhost
