/// \file
/// The sample inventories of the instrumentation library, for the tests' own one.
#ifndef TESTING_SAMPLEINVENTORIES_H
#define TESTING_SAMPLEINVENTORIES_H

#include "testing/MadeInventory.h"

#include <string>
#include <vector>

/// The nodes of a sample, all kinds of them. \param name  of the file, such as "small-server.json"
std::vector<MadeInventory::Node> sampleInventory(const std::string& name);

#endif
