/// \file
/// Which properties a request asks for.
#ifndef TAVRO_GLIMMARK_REQUESTEDPROPERTIES_H
#define TAVRO_GLIMMARK_REQUESTEDPROPERTIES_H

#include <cstdint>
#include <cstring>

namespace Tavro::GlimmarkProvider {

/// A view of a broker's property list; keys are outside its say.
class RequestedProperties
{
public:
    /// \param properties  names ended by a null pointer; null: all properties
    /// \param keysOnly    what a null list stands for: no property instead of all
    RequestedProperties(const char** properties, bool keysOnly) : names(properties), all(!keysOnly) {}

    /// Whether the property is asked for. Names match exactly, letter case included.
    bool include(const char* name) const { return names != nullptr ? isListed(name) : all; }

private:
    bool isListed(const char* name) const
    {
        // The position is 16 bits wide: no list is read past its 65,536th name.
        std::uint16_t position = 0;
        do {
            if (names[position] == nullptr)
                return false;
            if (std::strcmp(names[position], name) == 0)
                return true;
        } while (++position != 0);
        return false;
    }

    const char** names;
    bool all;
};

} // namespace Tavro::GlimmarkProvider

#endif
