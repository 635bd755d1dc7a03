/// \file
/// What `cimhost watch` shows on a terminal.
#ifndef CIMHOST_CLI_WATCH_VIEW_H
#define CIMHOST_CLI_WATCH_VIEW_H

#include "cli/watch/Changes.h"

#include "cim/Model.h"

#include <cstddef>
#include <map>
#include <string>
#include <vector>

namespace cimhost::cli {

struct TerminalSize
{
    std::size_t columns;
    std::size_t rows;
};

/// What was seen so far.
class Watched
{
public:
    /// \param isWide  the table goes beyond the terminal's edge instead of fitting it
    explicit Watched(bool isWide = false) : isWide_(isWide) {}

    /// Takes the next answer in.
    /// \param time  of the answer, for people
    /// \return the changes, as lines with the time
    std::vector<std::string> take(const cim::Answer& answer, const std::string& time);

    /// Takes in what came on standard error meanwhile.
    void tell(const std::vector<std::string>& messages);

    /// The terminal's lines, as many as fit, none wider than it is; with escape sequences for colours if
    /// wanted. `*` marks an instance that altered, `+` one that appeared within the last few answers. Where
    /// not all instances fit, those that are marked or not well come first.
    [[nodiscard]] std::vector<std::string> frame(const std::string& title, TerminalSize size,
                                                 bool isColoured) const;

private:
    struct Mark
    {
        char sign;
        int answersLeft; ///< that it is still shown with
    };

    void mark(const std::vector<Change>& changes);
    [[nodiscard]] char signOf(const cim::Instance& instance) const;

    /// A change, and when it was seen.
    struct Seen
    {
        std::string time;
        Change change;
    };

    [[nodiscard]] std::string stateLine() const;
    [[nodiscard]] std::vector<std::string> linesBelow(TerminalSize size) const;

    bool isFirst_ = true;
    bool isWide_;
    std::string time_;
    std::string error_; ///< of the last answer; empty: it had none
    cim::Instances instances_;
    std::map<std::string, Mark> marks_; ///< by the look-up text of the path
    std::vector<Seen> recent_;          ///< the last changes, newest last
    std::vector<std::string> messages_; ///< the last ones, newest last
};

} // namespace cimhost::cli

#endif
