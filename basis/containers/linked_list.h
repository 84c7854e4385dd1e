/// \file
/// A doubly linked list of nodes that carry their own links and that the list does not own.

#ifndef BASIS_CONTAINERS_LINKED_LIST_H
#define BASIS_CONTAINERS_LINKED_LIST_H

#include <cstdint>

namespace ZOR_Basis {

/// \tparam Node  has the members `Node* previous` and `Node* next`
template <class Node>
class LinkedList {
public:
    Node* first() const { return first_; }
    std::uint64_t size() const { return count_; }

    void append(Node* node) {
        node->previous = last_;
        node->next = nullptr;
        (last_ != nullptr ? last_->next : first_) = node;
        last_ = node;
        ++count_;
    }

    /// The node keeps its own links.
    /// \pre it is in the list
    void unlink(Node* node) {
        (node->previous != nullptr ? node->previous->next : first_) = node->next;
        (node->next != nullptr ? node->next->previous : last_) = node->previous;
        --count_;
    }

    /// \return the first node, which is no longer in the list; null if there was none
    Node* takeFirst() {
        Node* const node = first_;
        if (node == nullptr) return nullptr;
        first_ = node->next;
        (first_ != nullptr ? first_->previous : last_) = nullptr;
        --count_;
        return node;
    }

private:
    Node* first_ = nullptr;
    Node* last_ = nullptr;
    std::uint64_t count_ = 0;
};

} // namespace ZOR_Basis

#endif
