/// \file
/// Where the nodes of a list come from: a manager of elements, or the heap.

#ifndef BASIS_MEMORY_NODE_MEMORY_H
#define BASIS_MEMORY_NODE_MEMORY_H

#include "zor_basis/memory/mem_mgr.h"

#include <new>
#include <utility>

namespace ZOR_Basis {

/// \param manager  null: the heap. \return null where memory is short
template <class Node, class... Arguments>
Node* makeNode(MemMgr* manager, Arguments&&... arguments) {
    void* const memory = manager != nullptr ? manager->alloc() : ::operator new(sizeof(Node), std::nothrow);
    return memory != nullptr ? new (memory) Node{std::forward<Arguments>(arguments)...} : nullptr;
}

template <class Node>
void deleteNode(MemMgr* manager, Node* node) {
    node->~Node();
    if (manager != nullptr) {
        manager->free(node);
    } else {
        ::operator delete(node);
    }
}

} // namespace ZOR_Basis

#endif
