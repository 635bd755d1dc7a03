/// \file
/// Lists as this library counts them.
#ifndef TAVRO_GLIMMARK_COUNTED_H
#define TAVRO_GLIMMARK_COUNTED_H

#include <cstddef>
#include <cstdint>
#include <vector>

namespace Tavro::GlimmarkProvider {

/// A length in 16 bits: that of 65,536 items is 0.
///
/// Deliberate: no list is walked further; clients rely on an answer never being longer than 16 bits count.
/// Test: LargeInventoriesOf.AreCountedWith16Bits.
template <class Item>
std::uint16_t countOf(const std::vector<Item>& list)
{
    return static_cast<std::uint16_t>(list.size());
}

/// The items of a list that are counted, for a loop. Neither copies nor keeps the list.
template <class List>
class Counted
{
public:
    explicit Counted(List& list) : items(list) {}

    [[nodiscard]] auto begin() const { return items.begin(); }
    [[nodiscard]] auto end() const { return items.begin() + static_cast<std::ptrdiff_t>(countOf(items)); }

private:
    List& items;
};

} // namespace Tavro::GlimmarkProvider

#endif
