#include "serve/Text.h"

#include <algorithm>
#include <utility>

namespace cimhost::serve {

namespace {

/// Many beside what an allocation costs, few beside what a text may have.
constexpr std::size_t pieceSize = 65536;

} // namespace

bool TextBudget::take(std::size_t bytes)
{
    std::size_t left = left_;
    while (left >= bytes)
        if (left_.compare_exchange_weak(left, left - bytes))
            return true;
    return false;
}

Text::Text(std::string text) : size_(text.size())
{
    pieces_.push_back(std::move(text));
}

Text::~Text()
{
    while (!pieces_.empty())
        dropFirst();
}

Text::Text(Text&& other) noexcept
    : budget_(std::move(other.budget_)),
      pieces_(std::exchange(other.pieces_, {})),
      size_(std::exchange(other.size_, 0)),
      readOfFirst_(std::exchange(other.readOfFirst_, 0))
{}

Text& Text::operator=(Text&& other) noexcept
{
    std::swap(budget_, other.budget_);
    std::swap(pieces_, other.pieces_);
    std::swap(size_, other.size_);
    std::swap(readOfFirst_, other.readOfFirst_);
    return *this;
}

void Text::append(std::string_view text)
{
    while (!text.empty()) {
        if (pieces_.empty() || pieces_.back().size() >= pieceSize) {
            if (budget_ && !budget_->take(pieceSize))
                throw TextTooLong("the answers that are being given take all the memory that they may");
            pieces_.emplace_back().reserve(pieceSize);
        }
        const std::string_view now = text.substr(0, pieceSize - pieces_.back().size());
        pieces_.back() += now;
        size_ += now.size();
        text.remove_prefix(now.size());
    }
}

std::size_t Text::read(char* to, std::size_t most)
{
    std::size_t count = 0;
    while (count < most && !pieces_.empty()) {
        const std::string_view left = std::string_view(pieces_.front()).substr(readOfFirst_);
        const std::size_t now = left.copy(to + count, most - count);
        count += now;
        readOfFirst_ += now;
        if (now == left.size())
            dropFirst();
    }
    return count;
}

std::string Text::whole() const
{
    std::string text;
    for (const std::string& piece : pieces_)
        text += piece;
    return text.substr(std::min(readOfFirst_, text.size()));
}

void Text::dropFirst()
{
    if (budget_)
        budget_->giveBack(pieceSize);
    pieces_.pop_front();
    readOfFirst_ = 0;
}

} // namespace cimhost::serve
