/// \file
/// The instrumentation library of the tests: libtavro-instrumentation.so.1 whose nodes a test makes.
#ifndef TESTING_MADEINVENTORY_H
#define TESTING_MADEINVENTORY_H

#include <exception>
#include <optional>
#include <string>
#include <vector>

namespace MadeInventory {

struct Node
{
    std::string description;
    std::string path;
    unsigned int status = 1;
    std::optional<unsigned int> alarmState = std::nullopt; ///< nothing: getProperty answers false
    unsigned int kind = 36;
};

/// What every cursor made from now on walks over.
void set(std::vector<Node> nodes);

/// From now on, reading the description of the node at this position of the inventory throws. Set anew
/// by set(). \param position  nothing: none throws
void throwAt(std::optional<std::size_t> position, std::exception_ptr exception);

/// Cursors made and not yet destroyed.
int openCursors();

/// How often a kind was selected, by all cursors: an inventory library may read the hardware each time.
int selections();

/// What a getProperty read into `value` before it was answered, at the last call.
unsigned int valueBeforeGetProperty();

} // namespace MadeInventory

#endif
