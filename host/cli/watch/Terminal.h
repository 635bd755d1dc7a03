/// \file
/// A terminal that shows one screen after the other.
#ifndef CIMHOST_CLI_WATCH_TERMINAL_H
#define CIMHOST_CLI_WATCH_TERMINAL_H

#include "cli/watch/View.h"

#include <optional>
#include <string>
#include <vector>

#include <termios.h>

namespace cimhost::cli {

/// Writes the whole text to standard output.
/// \throws std::system_error
void writeNow(const std::string& text);

/// While the object lives, the terminal of standard output shows its screens in place of what it showed
/// before, without a cursor, and does not show what is typed.
class Terminal
{
public:
    /// \throws std::system_error
    Terminal();
    ~Terminal();
    Terminal(const Terminal&) = delete;
    Terminal& operator=(const Terminal&) = delete;

    /// \throws std::system_error
    void show(const std::vector<std::string>& lines) const;
    [[nodiscard]] static TerminalSize size();

    /// Where keys come from; -1: nowhere.
    [[nodiscard]] int keyboard() const;
    /// Takes the keys that were pressed.
    /// \return whether one of them asks for the end, or the keyboard is gone
    [[nodiscard]] bool isEndAsked() const;

private:
    std::optional<termios> before_;
};

} // namespace cimhost::cli

#endif
