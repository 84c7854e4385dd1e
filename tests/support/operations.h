/// \file
/// Named operations of model tests: each acts on the object under test and on its model.

#ifndef TESTS_SUPPORT_OPERATIONS_H
#define TESTS_SUPPORT_OPERATIONS_H

#include <cstddef>
#include <cstdint>

template <class Subject>
struct Operation {
    char const* name;
    /// How often it is drawn in proportion to the others.
    std::uint64_t weight;
    void (*act)(Subject& subject);
};

/// Draws one of the operations by weight.
template <class Subject, std::size_t N, class Random>
Operation<Subject> const& drawn(Operation<Subject> const (&operations)[N], Random& random) {
    std::uint64_t total = 0;
    for (auto const& operation : operations) total += operation.weight;
    std::uint64_t place = random() % total;
    std::size_t index = 0;
    while (place >= operations[index].weight) place -= operations[index++].weight;
    return operations[index];
}

#endif
