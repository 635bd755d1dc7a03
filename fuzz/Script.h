/// \file
/// A small language for sequences of steps: inputs that a person can read and write, and in which a fuzzer's
/// changes are mostly steps again.
///
/// A line is a step, words separated by blanks. In a word, %XX is the byte of that hexadecimal number. As an
/// argument `-` is a null pointer and `.` the empty text.
#ifndef FUZZ_SCRIPT_H
#define FUZZ_SCRIPT_H

#include <cstddef>
#include <optional>
#include <string>
#include <vector>

namespace Fuzz {

/// One line.
class Step
{
public:
    explicit Step(const std::string& line);

    /// The first word; empty in an empty line.
    [[nodiscard]] const std::string& name() const { return name_; }

    /// An argument, counted from 0. Nothing: a null pointer, or no such argument.
    [[nodiscard]] std::optional<std::string> text(std::size_t position) const;
    /// An argument as a number, modulo 2^32; 0 where it is none.
    [[nodiscard]] unsigned int number(std::size_t position) const;
    /// An argument as a list of texts separated by commas. Nothing: a null list.
    [[nodiscard]] std::optional<std::vector<std::string>> list(std::size_t position) const;

private:
    std::string name_;
    std::vector<std::string> arguments_; ///< as they stand in the line
};

/// The steps of a script.
std::vector<Step> stepsOf(const std::string& script);

} // namespace Fuzz

#endif
