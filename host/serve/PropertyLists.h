/// \file
#ifndef CIMHOST_SERVE_PROPERTYLISTS_H
#define CIMHOST_SERVE_PROPERTYLISTS_H

#include "broker/Registration.h"
#include "cim/Model.h"
#include "schema/Classes.h"

#include <set>
#include <string>

namespace cimhost::serve {

/// Which names of a client's property list mean anything. A provider looks through the list at each property of each
/// instance: a list of thousands of names would cost as many steps at each.
class PropertyLists
{
public:
    PropertyLists(const schema::Classes& classes, const Registration& registration);

    /// Drops names that are there again and, where all classes that are served are known, those that no class
    /// has, but one; DMTF DSP0200 has a server ignore both. Nothing: there is no list.
    void shorten(cim::PropertyList& list) const;

private:
    [[nodiscard]] bool isMeaningful(const std::string& name) const;

    bool areAllKnown_ = false;          ///< the classes that are served
    std::set<std::string> declared_;    ///< as the classes spell them
    std::set<std::string> inLowerCase_; ///< the same
};

} // namespace cimhost::serve

#endif
