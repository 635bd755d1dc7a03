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
    explicit Descriptor(int number) : number_(number) {}
    ~Descriptor()
    {
        if (isOpen())
            close(number_);
    }
    Descriptor(Descriptor&& other) noexcept : number_(std::exchange(other.number_, -1)) {}
    Descriptor& operator=(Descriptor&&) = delete;
    Descriptor(const Descriptor&) = delete;
    Descriptor& operator=(const Descriptor&) = delete;

    [[nodiscard]] bool isOpen() const { return number_ >= 0; }
    [[nodiscard]] int number() const { return number_; }

private:
    int number_;
};

} // namespace Tavro

#endif
