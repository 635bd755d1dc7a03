/// \file
/// The library's one exception class.
#ifndef TAVRO_PROVIDEREXCEPTION_H
#define TAVRO_PROVIDEREXCEPTION_H

#include <exception>
#include <string>

namespace Tavro {

/// A node of the inventory that no record can be made of. Thrown and caught inside the inventory
/// collection; it never reaches a broker.
class ProviderException : public std::exception
{
public:
    /// \param text  the message; copied; not null
    explicit ProviderException(const char* text);
    ProviderException(const ProviderException& other);
    ProviderException& operator=(const ProviderException&) = delete;
    ~ProviderException() override;

    /// The message; lives as long as the exception.
    [[nodiscard]] const char* what() const noexcept override;

private:
    std::string message;
};

} // namespace Tavro

#endif
