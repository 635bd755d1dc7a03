/// \file
/// A value that is copied by reference until somebody changes it.
#ifndef CIMHOST_CIM_COPYONWRITE_H
#define CIMHOST_CIM_COPYONWRITE_H

#include <memory>
#include <utility>

namespace cimhost::cim {

/// Holds a T that others may share as unchangeable; changing it copies it first if anybody does.
template <class T>
class CopyOnWrite
{
public:
    explicit CopyOnWrite(T value) { own(std::move(value)); }
    /// \param shared  not null
    explicit CopyOnWrite(std::shared_ptr<const T> shared) : value_(std::move(shared)) {}

    [[nodiscard]] const T& read() const { return *value_; }
    [[nodiscard]] std::shared_ptr<const T> share() const { return value_; }
    T& edit()
    {
        if (own_ == nullptr || value_.use_count() > 1)
            own(*value_);
        return *own_;
    }

private:
    void own(T value)
    {
        const auto made = std::make_shared<T>(std::move(value));
        own_ = made.get();
        value_ = made;
    }

    std::shared_ptr<const T> value_;
    T* own_ = nullptr; ///< the value, when it was made here and may thus be changed here
};

} // namespace cimhost::cim

#endif
