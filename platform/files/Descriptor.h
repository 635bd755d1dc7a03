/// \file
#ifndef TAVRO_DESCRIPTOR_H
#define TAVRO_DESCRIPTOR_H

#include <utility>

#include <unistd.h>

namespace Tavro {

/// A file descriptor, closed when the object goes; or none.
class Descriptor
{
public:
    /// Takes the descriptor over.
    /// \param number  as open() answers it: -1 is none
    explicit Descriptor(int number = -1) : number_(number) {}
    ~Descriptor()
    {
        if (isOpen())
            close(number_);
    }
    Descriptor(Descriptor&& other) noexcept : number_(std::exchange(other.number_, -1)) {}
    /// What was held is closed with the other object.
    Descriptor& operator=(Descriptor&& other) noexcept
    {
        std::swap(number_, other.number_);
        return *this;
    }
    Descriptor(const Descriptor&) = delete;
    Descriptor& operator=(const Descriptor&) = delete;

    [[nodiscard]] bool isOpen() const { return number_ >= 0; }
    [[nodiscard]] int number() const { return number_; }
    /// Hands it over: it is the caller's to close.
    [[nodiscard]] int release() { return std::exchange(number_, -1); }

private:
    int number_;
};

} // namespace Tavro

#endif
