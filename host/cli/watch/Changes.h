/// \file
/// What is different between two answers.
#ifndef CIMHOST_CLI_WATCH_CHANGES_H
#define CIMHOST_CLI_WATCH_CHANGES_H

#include "cim/Model.h"
#include "cli/FittedTable.h"

#include <string>
#include <vector>

namespace cimhost::cli {

struct Change
{
    enum Kind
    {
        appeared,
        vanished,
        altered,
    };

    Kind kind;
    cim::Instance instance; ///< as it is now; of one that vanished, as it was
    /// Of one that altered: the property, and its value before and now. A null of no type: there was none.
    std::string property;
    cim::Value before;
    cim::Value now;
};

/// What happened from one answer to the next: first what altered and appeared, in the order of the next
/// answer and of an instance's properties; then what vanished, in the order of the first. Instances are the
/// same by their paths, properties by their names.
std::vector<Change> changesBetween(const cim::Instances& before, const cim::Instances& now);

/// The change in one line that may go to a terminal: the keys that tell the instance, and what happened.
/// States are in words.
/// \param width  of the terminal; the keys are shortened first
std::string changeText(const Change& change, std::size_t width = anyWidth);

} // namespace cimhost::cli

#endif
