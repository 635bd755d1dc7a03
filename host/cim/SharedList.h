/// \file
/// A list whose elements are copied by reference until somebody changes one.
#ifndef CIMHOST_CIM_SHAREDLIST_H
#define CIMHOST_CIM_SHAREDLIST_H

#include "cim/CopyOnWrite.h"

#include <algorithm>
#include <cstddef>
#include <initializer_list>
#include <iterator>
#include <memory>
#include <utility>
#include <vector>

namespace cimhost::cim {

/// Reads like a vector of T. Who copies the list or takes a part of it shares the elements; changing one copies it
/// first if anybody shares it.
template <class T>
class SharedList
{
public:
    using value_type = T;
    using const_reference = const T&;
    class const_iterator;
    using iterator = const_iterator;

    SharedList() = default;
    SharedList(std::initializer_list<T> values) : elements_(values.begin(), values.end()) {}

    [[nodiscard]] std::size_t size() const { return elements_.size(); }
    [[nodiscard]] bool empty() const { return elements_.empty(); }
    [[nodiscard]] const_iterator begin() const { return const_iterator(elements_.begin()); }
    [[nodiscard]] const_iterator end() const { return const_iterator(elements_.end()); }
    const T& operator[](std::size_t index) const { return elements_[index].read(); }
    /// \throws std::out_of_range  there is no such element
    [[nodiscard]] const T& at(std::size_t index) const { return elements_.at(index).read(); }
    [[nodiscard]] const T& front() const { return elements_.front().read(); }
    [[nodiscard]] const T& back() const { return elements_.back().read(); }

    /// The elements as they are shared.
    [[nodiscard]] const std::vector<CopyOnWrite<T>>& shared() const { return elements_; }
    /// At most that many, from that index on; none behind the end.
    [[nodiscard]] SharedList part(std::size_t from, std::size_t most) const
    {
        SharedList taken;
        const auto begin = elements_.begin() + static_cast<std::ptrdiff_t>(std::min(from, size()));
        const auto left = static_cast<std::size_t>(elements_.end() - begin);
        taken.elements_.assign(begin, begin + static_cast<std::ptrdiff_t>(std::min(most, left)));
        return taken;
    }
    /// At most that many, from that index on, which the list lets go of: they are not to be read from it any more.
    /// None behind the end.
    SharedList take(std::size_t from, std::size_t most)
    {
        SharedList taken;
        for (; from < size() && taken.size() < most; ++from)
            taken.elements_.push_back(std::move(elements_[from]));
        return taken;
    }
    /// \param use  called with each element, which goes then; the list is empty at the end
    template <class Use>
    void drain(const Use& use)
    {
        for (CopyOnWrite<T>& element : elements_)
            use(CopyOnWrite<T>(std::move(element)).read());
        elements_.clear();
    }

    friend bool operator==(const SharedList& left, const SharedList& right)
    {
        return std::equal(left.begin(), left.end(), right.begin(), right.end());
    }

    void push_back(CopyOnWrite<T> element) { elements_.push_back(std::move(element)); }
    void push_back(T element) { elements_.emplace_back(std::move(element)); }
    void append(const SharedList& more)
    {
        elements_.insert(elements_.end(), more.elements_.begin(), more.elements_.end());
    }
    template <class Condition>
    void removeIf(const Condition& condition)
    {
        const auto applies = [&](const CopyOnWrite<T>& element) { return condition(element.read()); };
        elements_.erase(std::remove_if(elements_.begin(), elements_.end(), applies), elements_.end());
    }
    /// \param change  called with each element as one that may be changed
    template <class Change>
    void edit(const Change& change)
    {
        for (CopyOnWrite<T>& element : elements_)
            change(element.edit());
    }
    T& editBack() { return elements_.back().edit(); }

private:
    std::vector<CopyOnWrite<T>> elements_;
};

template <class T>
class SharedList<T>::const_iterator
{
public:
    using iterator_category = std::forward_iterator_tag;
    using value_type = T;
    using difference_type = std::ptrdiff_t;
    using pointer = const T*;
    using reference = const T&;

    const_iterator() = default;
    explicit const_iterator(typename std::vector<CopyOnWrite<T>>::const_iterator position)
        : position_(position)
    {}

    reference operator*() const { return position_->read(); }
    pointer operator->() const { return &position_->read(); }
    const_iterator& operator++()
    {
        ++position_;
        return *this;
    }
    const_iterator operator++(int) { return const_iterator(position_++); }
    friend bool operator==(const_iterator left, const_iterator right)
    {
        return left.position_ == right.position_;
    }
    friend bool operator!=(const_iterator left, const_iterator right) { return !(left == right); }

private:
    typename std::vector<CopyOnWrite<T>>::const_iterator position_;
};

} // namespace cimhost::cim

#endif
