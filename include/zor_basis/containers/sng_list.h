/// \file
/// `SngList<T>`: a singly linked list of units, each with a link and a value.
///
/// The list owns its units, which it makes by `new` and deletes by `delete`. A unit that is taken out (`take`,
/// `takeFirst`) belongs to the caller, who returns it to a list or deletes it; a unit that is inserted is adopted. A
/// position is an iterator, which also knows the previous unit so that it can remove and insert there; any other change
/// of the list at that place invalidates it.
///
///     SngList<int> list;
///     list.insertBack(2);
///     list.insertFront(1);
///     for (auto it = list.begin(); it != list.end();) *it % 2 == 0 ? list.remove(it) : void(++it);
///
/// Only the members that copy require copyable values, and only those that sort require `<`. Moving a list moves its
/// chain: units stay where they are, and pointers to them stay valid.
///
/// \thread one thread at a time
/// \error throws `std::bad_alloc` if memory for a unit is short

#ifndef ZOR_BASIS_CONTAINERS_SNG_LIST_H
#define ZOR_BASIS_CONTAINERS_SNG_LIST_H

#include "zor_basis/export.h"

#include <algorithm>
#include <cstddef>
#include <cstdint>
#include <cstdlib>
#include <iterator>
#include <utility>

namespace ZOR_Basis {

namespace detail {

/// The number of units of a list. For some types of value it also notes that units are exposed: callers may hold
/// pointers to them, through which they can change values and links unnoticed.
template <class T>
struct UnitCount {
    std::uint64_t number = 0;
    void noteExposure() const {}
};

} // namespace detail

template <class T>
class SngList {
public:
    /// One link of the list.
    struct Unit {
        Unit* next; ///< null at the end
        T value;    ///< is the list's own
    };

    /// Changes the values of a list, and names the place for an insertion or a removal.
    class iterator {
    public:
        /// What the standard library asks of an iterator.
        using iterator_category = std::forward_iterator_tag;
        using value_type = T;
        using difference_type = std::ptrdiff_t;
        using pointer = T*;
        using reference = T&;

        iterator() = default;
        /// The value of the unit.
        /// \pre not at the end
        T& operator*() const { return current_->value; }
        T* operator->() const { return &current_->value; }
        /// The unit itself; null at the end.
        Unit* unit() const { return current_; }
        /// Advances to the next unit.
        /// \pre not at the end
        iterator& operator++() {
            previous_ = current_;
            current_ = current_->next;
            return *this;
        }
        iterator operator++(int) {
            iterator const before = *this;
            ++*this;
            return before;
        }
        /// Tells whether both are at the same unit.
        bool operator==(iterator const& other) const { return current_ == other.current_; }
        bool operator!=(iterator const& other) const { return current_ != other.current_; }

    private:
        friend SngList;
        iterator(Unit* current, Unit* previous) : current_(current), previous_(previous) {}

        Unit* current_ = nullptr;
        Unit* previous_ = nullptr;
    };

    /// Reads the values of a list. Every iterator converts to one.
    class const_iterator {
    public:
        /// What the standard library asks of an iterator.
        using iterator_category = std::forward_iterator_tag;
        using value_type = T;
        using difference_type = std::ptrdiff_t;
        using pointer = T const*;
        using reference = T const&;

        const_iterator() = default;
        /// Reads from the place of an iterator.
        const_iterator(iterator const& other) : current_(other.unit()) {}
        /// The value of the unit.
        /// \pre not at the end
        T const& operator*() const { return current_->value; }
        T const* operator->() const { return &current_->value; }
        /// The unit itself; null at the end.
        Unit const* unit() const { return current_; }
        const_iterator& operator++() {
            current_ = current_->next;
            return *this;
        }
        const_iterator operator++(int) {
            const_iterator const before = *this;
            ++*this;
            return before;
        }
        friend bool operator==(const_iterator const& a, const_iterator const& b) { return a.current_ == b.current_; }

    private:
        friend SngList;
        explicit const_iterator(Unit const* current) : current_(current) {}

        Unit const* current_ = nullptr;
    };

    SngList() = default;
    /// Adopts a chain without changing it.
    /// \pre `count` units lead from `first` to `last`, whose link is null
    SngList(Unit* first, Unit* last, std::uint64_t count) : first_(first), last_(last), count_{count} {}
    /// Copies the values in their order.
    SngList(SngList const& other) : SngList() {
        for (Unit* unit = other.first_; unit != nullptr; unit = unit->next) insertBack(unit->value);
    }
    /// Takes the units of the other list, which becomes empty.
    SngList(SngList&& other) noexcept { swap(other); }
    SngList& operator=(SngList const& other) {
        if (this != &other) {
            SngList copy(other);
            swap(copy);
        }
        return *this;
    }
    /// Deletes its own units and takes those of the other list, which becomes empty. Self-assignment does nothing.
    SngList& operator=(SngList&& other) noexcept {
        if (this != &other) {
            SngList taken(std::move(other));
            swap(taken);
        }
        return *this;
    }
    ~SngList() { clear(); }

    /// Deletes all units, from the front.
    void clear() {
        while (first_ != nullptr) delete std::exchange(first_, first_->next);
        last_ = nullptr;
        count_.number = 0;
    }

    /// The first and the last unit; null in an empty list.
    Unit* first() const { return exposed(first_); }
    Unit* last() const { return exposed(last_); }
    /// The number of units.
    std::uint64_t size() const { return count_.number; }
    bool empty() const { return count_.number == 0; }
    /// The place of the first unit, and the end behind the last.
    iterator begin() { return {exposed(first_), nullptr}; }
    iterator end() { return {}; }
    const_iterator begin() const { return const_iterator(exposed(first_)); }
    const_iterator end() const { return {}; }
    const_iterator cbegin() const { return begin(); }
    const_iterator cend() const { return end(); }

    /// Inserts at the front or at the back, a new unit with a copy of the value or an adopted one.
    void insertFront(T const& value) { insertFront(new Unit{nullptr, value}); }
    void insertFront(Unit* unit) { linkFront(exposed(unit)); }
    void insertBack(T const& value) { insertBack(new Unit{nullptr, value}); }
    void insertBack(Unit* unit) {
        unit->next = nullptr;
        (last_ != nullptr ? last_->next : first_) = exposed(unit);
        last_ = unit;
        ++count_.number;
    }

    /// Inserts after the iterator's unit; appends at the end of the list and for an iterator without a unit.
    void insertAfter(T const& value, iterator& place) { insertAfter(new Unit{nullptr, value}, place); }
    void insertAfter(Unit* unit, iterator& place) {
        if (place.current_ == nullptr || place.current_ == last_) {
            insertBack(unit);
        } else {
            link(unit, place.current_);
        }
    }
    /// Inserts before the iterator's unit; the iterator keeps its unit. Appends for an iterator without a unit.
    void insertBefore(T const& value, iterator& place) { insertBefore(new Unit{nullptr, value}, place); }
    void insertBefore(Unit* unit, iterator& place) {
        if (place.current_ == nullptr) {
            insertBack(unit);
            return;
        }
        if (place.current_ == first_) {
            insertFront(unit);
        } else {
            link(unit, place.previous_);
        }
        place.previous_ = unit;
    }

    /// Deletes the iterator's unit and moves the iterator to the next one; does nothing without a unit.
    void remove(iterator& place) { delete take(place); }
    /// Takes the iterator's unit out and moves the iterator to the next one.
    /// \return the unit with its value, which the caller now owns; null without a unit
    Unit* take(iterator& place) {
        if (place.current_ == nullptr) return nullptr;
        Unit* const taken = unlink(place.previous_, place.current_);
        place.current_ = taken->next;
        taken->next = nullptr;
        return taken;
    }
    /// The same for the first unit.
    void removeFirst() { delete takeFirst(); }
    Unit* takeFirst() {
        if (first_ == nullptr) return nullptr;
        Unit* const taken = exposed(unlink(nullptr, first_));
        taken->next = nullptr;
        return taken;
    }

    /// Reverses the order, in place.
    void reverse() {
        Unit* reversed = nullptr;
        last_ = first_;
        for (Unit* unit = first_; unit != nullptr;) {
            Unit* const next = std::exchange(unit->next, reversed);
            reversed = std::exchange(unit, next);
        }
        first_ = reversed;
    }

    /// Sorts by changing links; values do not move in memory. Equal values keep their order.
    /// \kept list-01: a list of exactly two units is an exception: they are swapped unless the first comes strictly
    ///     before the second, so two equal ones change places
    /// \cost n log n comparisons, and during the call one pointer per unit, if memory allows
    void sort(bool ascending) {
        if (size() < 2) return;
        if (size() == 2) {
            // kept list-01: two units are compared once, and one that is not less goes behind.
            if (!comp(first_, last_, ascending)) reverse();
        } else if (!sortGathered(ascending)) {
            sortLinked(ascending);
        }
    }

    /// Merges another sorted list into this sorted one; the other becomes empty.
    /// \kept list-02: of equal values, those of the other list come first
    void merge(SngList& other, bool ascending) {
        if (this == &other || other.first_ == nullptr) return;
        Unit* mine = first_;
        Unit* theirs = other.first_;
        Unit** link = &first_;
        while (mine != nullptr && theirs != nullptr) {
            // kept list-02: sorting merges the first half as the other list, and so keeps equal values in order.
            Unit*& source = comp(mine, theirs, ascending) ? mine : theirs;
            *link = source;
            link = &source->next;
            source = source->next;
        }
        *link = mine != nullptr ? mine : theirs;
        if (theirs != nullptr) last_ = other.last_;
        count_.number += std::exchange(other.count_.number, 0);
        other.first_ = other.last_ = nullptr;
        exposed(first_);
    }

    /// Tells whether a comes strictly before b.
    static bool comp(Unit* a, Unit* b, bool ascending) { return ascending ? a->value < b->value : b->value < a->value; }

    /// Tells whether links, tail and count agree.
    /// \cost a walk over all units
    bool isConsistent() const {
        std::uint64_t units = 0;
        Unit const* tail = nullptr;
        for (Unit const* unit = first_; unit != nullptr && units <= size(); unit = unit->next, ++units) tail = unit;
        return units == size() && tail == last_;
    }

protected:
    /// \name For a derived class that keeps account of its units: none of these exposes them
    /// @{
    /// The first unit, how many there are, and the insertion of one at the front.
    Unit* head() const { return first_; }
    detail::UnitCount<T> const& unitCount() const { return count_; }
    void linkFront(Unit* unit) {
        unit->next = first_;
        first_ = unit;
        if (last_ == nullptr) last_ = unit;
        ++count_.number;
    }
    /// \param previous  is null for the first unit
    Unit* unlink(Unit* previous, Unit* unit) {
        (previous != nullptr ? previous->next : first_) = unit->next;
        if (unit == last_) last_ = previous;
        --count_.number;
        return unit;
    }
    /// @}

private:
    /// Notes that callers may hold units now. Members that take an iterator to a unit need not: `begin` has done so.
    Unit* exposed(Unit* unit) const {
        count_.noteExposure();
        return unit;
    }

    void swap(SngList& other) noexcept {
        std::swap(first_, other.first_);
        std::swap(last_, other.last_);
        std::swap(count_.number, other.count_.number);
        exposed(first_);
    }

    /// Inserts a unit after one that is not the last.
    void link(Unit* unit, Unit* previous) {
        unit->next = previous->next;
        previous->next = unit;
        ++count_.number;
    }

    /// Sorts an array of pointers to the units and links the units again, which is faster than following links.
    /// \return false, with nothing changed, if memory for the array is short
    bool sortGathered(bool ascending) {
        Unit** const units = static_cast<Unit**>(std::malloc(size() * sizeof(Unit*)));
        if (units == nullptr) return false;
        Unit** end = units;
        for (Unit* unit = first_; unit != nullptr; unit = unit->next) *end++ = unit;
        if (ascending) {
            std::stable_sort(units, end, [](Unit* a, Unit* b) { return comp(a, b, true); });
        } else {
            std::stable_sort(units, end, [](Unit* a, Unit* b) { return comp(a, b, false); });
        }
        for (Unit** unit = units; unit + 1 != end; ++unit) (*unit)->next = unit[1];
        first_ = units[0];
        last_ = end[-1];
        last_->next = nullptr;
        std::free(units);
        return true;
    }

    void sortLinked(bool ascending) {
        if (size() < 2) return;
        Unit* cut = first_;
        for (std::uint64_t i = 1; i < size() / 2; ++i) cut = cut->next;
        SngList front(first_, cut, size() / 2);
        first_ = std::exchange(cut->next, nullptr);
        count_.number -= front.size();
        front.sortLinked(ascending);
        sortLinked(ascending);
        merge(front, ascending);
    }

    Unit* first_ = nullptr;
    Unit* last_ = nullptr;
    detail::UnitCount<T> count_;
};

} // namespace ZOR_Basis

#endif
