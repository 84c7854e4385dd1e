#include "basis/containers/linked_list.h"

#include <gtest/gtest.h>

#include <vector>

using namespace ZOR_Basis;

namespace {

struct Node {
    int number;
    Node* previous = nullptr;
    Node* next = nullptr;
};

/// The numbers from the first to the last; empty if the links backwards do not agree.
std::vector<int> numbers(LinkedList<Node> const& list) {
    std::vector<int> all;
    Node const* before = nullptr;
    for (Node const* node = list.first(); node != nullptr; node = node->next) {
        if (node->previous != before) return {};
        all.push_back(node->number);
        before = node;
    }
    return all.size() == list.size() ? all : std::vector<int>();
}

using Numbers = std::vector<int>;

} // namespace

TEST(LinkedList, keeps_the_order_of_appending) {
    LinkedList<Node> list;
    EXPECT_EQ(list.first(), nullptr);
    Node nodes[] = {{1}, {2}, {3}, {4}};
    for (Node& node : nodes) list.append(&node);
    EXPECT_EQ(numbers(list), (Numbers{1, 2, 3, 4}));
}

TEST(LinkedList, unlinks_the_first_the_last_one_between_and_the_only_one) {
    LinkedList<Node> list;
    Node nodes[] = {{1}, {2}, {3}, {4}};
    for (Node& node : nodes) list.append(&node);
    list.unlink(&nodes[1]);
    EXPECT_EQ(numbers(list), (Numbers{1, 3, 4}));
    list.unlink(&nodes[3]);
    EXPECT_EQ(numbers(list), (Numbers{1, 3}));
    list.append(&nodes[1]);
    EXPECT_EQ(numbers(list), (Numbers{1, 3, 2}));
    list.unlink(&nodes[0]);
    list.unlink(&nodes[2]);
    EXPECT_EQ(numbers(list), (Numbers{2}));
    list.unlink(&nodes[1]);
    EXPECT_EQ(list.first(), nullptr);
    EXPECT_EQ(list.size(), 0u);
    list.append(&nodes[3]);
    EXPECT_EQ(numbers(list), (Numbers{4}));
}

TEST(LinkedList, gives_the_first_away) {
    LinkedList<Node> list;
    EXPECT_EQ(list.takeFirst(), nullptr);
    Node nodes[] = {{1}, {2}, {3}};
    for (Node& node : nodes) list.append(&node);
    EXPECT_EQ(list.takeFirst(), &nodes[0]);
    EXPECT_EQ(numbers(list), (Numbers{2, 3}));
    EXPECT_EQ(list.takeFirst(), &nodes[1]);
    EXPECT_EQ(list.takeFirst(), &nodes[2]);
    EXPECT_EQ(list.takeFirst(), nullptr);
    EXPECT_EQ(list.size(), 0u);
    list.append(&nodes[2]);
    EXPECT_EQ(numbers(list), (Numbers{3}));
}
