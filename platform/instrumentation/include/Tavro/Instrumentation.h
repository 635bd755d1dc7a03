/// \file
/// The hardware inventory of this server.
///
/// The environment variable TAVRO_INVENTORY chooses where it is read from. "sysfs", and the variable unset
/// or empty: the LEDs and drive enclosures that Linux shows in sysfs, below TAVRO_SYSFS_ROOT, by default
/// /sys. Anything else: a JSON file of that name.
///
/// A file that cannot be read or is not an inventory in every detail counts as an empty one; one error line
/// in the log says which file, where in it, and what was expected. So does a root of sysfs that is none.
#ifndef TAVRO_INSTRUMENTATION_H
#define TAVRO_INSTRUMENTATION_H

#include "Tavro/NodeLexicon.h"

#include <memory>
#include <string>

namespace Tavro {

/// A cursor over the nodes of one kind, in the inventory's order. It sees the inventory as it was when
/// the cursor was made. One thread at a time may use a cursor; any number of cursors may be in use.
///
/// While the cursor stands on no node, texts are empty, the status is 0 and properties are absent.
/// Nothing but std::bad_alloc is thrown.
class Instrumentation
{
public:
    /// Reads the inventory; the cursor stands on no node.
    Instrumentation();
    ~Instrumentation();

    Instrumentation(const Instrumentation&) = delete;
    Instrumentation& operator=(const Instrumentation&) = delete;

    /// Stands on the first node of that kind, or on none if there is none. May be called again.
    ///
    /// A diagnostic indicator without a description is told in one error line in the log whenever the
    /// indicators are selected, since it costs the provider all of them.
    void selectNode(NodeLexicon::NodeType kind);

    /// True while the cursor stands on a node.
    operator bool() const;

    /// Steps to the next node of the selected kind, or off the end; past the end it stays there.
    Instrumentation& operator++();

    /// The inventory's own path of the node.
    [[nodiscard]] std::string getPathToNode() const;

    /// What is shown to people for a path of this inventory: for a node of sysfs its place among the devices
    /// of its class. A file's paths, and those of no node, are shown as they stand.
    [[nodiscard]] std::string convertPathToString(const std::string& path) const;

    /// The node's description, as it stands in the inventory.
    [[nodiscard]] std::string getNodeDescription() const;

    /// The raw status code of the node.
    [[nodiscard]] unsigned int getNodeStatus() const;

    /// Reads a property of the node.
    /// \param value  left untouched when the answer is false
    /// \return whether the node has the property
    bool getProperty(NodeLexicon::Properties property, unsigned int& value) const;

private:
    struct Implementation;
    std::unique_ptr<Implementation> implementation_;
};

} // namespace Tavro

#endif
