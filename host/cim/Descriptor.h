/// \file
#ifndef CIMHOST_CIM_DESCRIPTOR_H
#define CIMHOST_CIM_DESCRIPTOR_H

#include <utility>

#include <unistd.h>

namespace cimhost::cim {

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
    Descriptor(const Descriptor&) = delete;
    Descriptor& operator=(const Descriptor&) = delete;

    [[nodiscard]] bool isOpen() const { return number_ >= 0; }
    [[nodiscard]] int number() const { return number_; }
    /// Hands it over: it is the caller's to close.
    int release() { return std::exchange(number_, -1); }

private:
    int number_;
};

} // namespace cimhost::cim

#endif
