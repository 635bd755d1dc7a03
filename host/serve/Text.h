/// \file
/// Long texts, such as answers of a hundred megabytes, without a second copy while they grow or are sent.
#ifndef CIMHOST_SERVE_TEXT_H
#define CIMHOST_SERVE_TEXT_H

#include <atomic>
#include <cstddef>
#include <deque>
#include <memory>
#include <stdexcept>
#include <string>
#include <string_view>
#include <utility>

namespace cimhost::serve {

/// How many bytes several texts may take together. Safe to use from several threads at once.
class TextBudget
{
public:
    explicit TextBudget(std::size_t bytes) : left_(bytes) {}

    /// False: there are not so many left.
    bool take(std::size_t bytes);
    void giveBack(std::size_t bytes) { left_ += bytes; }

private:
    std::atomic<std::size_t> left_;
};

/// The budget is used up.
class TextTooLong : public std::runtime_error
{
public:
    using std::runtime_error::runtime_error;
};

/// A text in pieces, which grows at its end and is read from its beginning.
class Text
{
public:
    /// \param budget  what it takes of; null: as much as there is memory
    explicit Text(std::shared_ptr<TextBudget> budget = nullptr) : budget_(std::move(budget)) {}
    explicit Text(std::string text);
    ~Text();
    Text(Text&& other) noexcept;
    Text& operator=(Text&& other) noexcept;
    Text(const Text&) = delete;
    Text& operator=(const Text&) = delete;

    /// \throws TextTooLong
    void append(std::string_view text);

    /// All that was appended, read or not.
    [[nodiscard]] std::size_t size() const { return size_; }

    /// Copies at most that many of the bytes that were not read yet, and forgets those before them.
    /// \return how many there were; 0: all were read
    std::size_t read(char* to, std::size_t most);

    /// All that was not read yet.
    [[nodiscard]] std::string whole() const;

private:
    void dropFirst();

    std::shared_ptr<TextBudget> budget_;
    std::deque<std::string> pieces_;
    std::size_t size_ = 0;
    std::size_t readOfFirst_ = 0; ///< bytes of the first piece
};

} // namespace cimhost::serve

#endif
