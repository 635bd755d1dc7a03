/// \file
#ifndef CIMHOST_SERVE_SLOTS_H
#define CIMHOST_SERVE_SLOTS_H

#include <chrono>
#include <condition_variable>
#include <mutex>
#include <optional>
#include <utility>

namespace cimhost::serve {

/// How many may do something at once; others wait. Safe to use from several threads at once.
class Slots
{
public:
    explicit Slots(unsigned int count) : free_(count) {}

    /// One that is taken, for as long as it exists; outlived by its slots.
    class Taken
    {
    public:
        explicit Taken(Slots& slots) : slots_(&slots) {}
        ~Taken()
        {
            if (slots_ != nullptr)
                slots_->giveBack();
        }
        Taken(Taken&& other) noexcept : slots_(std::exchange(other.slots_, nullptr)) {}
        Taken(const Taken&) = delete;
        Taken& operator=(const Taken&) = delete;
        Taken& operator=(Taken&&) = delete;

    private:
        Slots* slots_;
    };

    /// Nothing: none has become free for so long.
    std::optional<Taken> take(std::chrono::milliseconds patience)
    {
        std::unique_lock<std::mutex> lock(mutex_);
        if (!changed_.wait_for(lock, patience, [&] { return free_ > 0; }))
            return std::nullopt;
        --free_;
        return std::optional<Taken>(std::in_place, *this);
    }

private:
    void giveBack()
    {
        {
            const std::lock_guard<std::mutex> lock(mutex_);
            ++free_;
        }
        changed_.notify_one();
    }

    std::mutex mutex_;
    std::condition_variable changed_;
    unsigned int free_;
};

} // namespace cimhost::serve

#endif
