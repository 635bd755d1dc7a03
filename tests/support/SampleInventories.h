/// \file
/// The sample inventories of the instrumentation library, for the tests' own one.
#ifndef TESTS_SUPPORT_SAMPLEINVENTORIES_H
#define TESTS_SUPPORT_SAMPLEINVENTORIES_H

#include "MadeInventory.h"

#include <string>
#include <vector>

/// The nodes of a sample, all kinds of them. \param name  of the file, such as "small-server.json"
std::vector<MadeInventory::Node> sampleInventory(const std::string& name);

#endif
