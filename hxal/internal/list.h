// The library's two kinds of singly linked list, linked through `next`: IOC handles and adapters.
//
// A list is its first node. Its nodes are allocated singly, so that handles keep their address while the list grows.
#pragma once

#include "hxal/adapter.h"
#include "hxal/internal/descriptor.h"

#include <memory>
#include <utility>

namespace hxal
{

// What every IOC handle of the library is underneath: the handle and its share of the node's descriptor, which is closed
// with the last handle that uses it.
struct Ioc_Node : hxal_s
{
    std::shared_ptr<Descriptor> node;
};

// Hangs a node behind the last one. The list owns it from then on.
template <typename Node> void list_append(Node*& head, Node* node)
{
    Node** end = &head;
    while (*end)
        end = &(*end)->next;
    *end = node;
}

// The first node that fits; none: null.
template <typename Node, typename Fits> Node* first_that(Node* head, Fits fits)
{
    while (head && !fits(*head))
        head = head->next;
    return head;
}

// The first node with that id; none: null.
template <typename Node> Node* find(Node* head, int id)
{
    return first_that(head, [=](const Node& node) { return node.id == id; });
}

// Frees every node and leaves the list empty. Adapters take their IOC copies along.
void list_free(hxal_s*& head);
void list_free(hxal_adapter_t*& head);

// Owns a list and its count, which is what the drivers claim and may exceed the nodes.
template <typename Node> struct List
{
    List() = default;
    ~List()
    {
        if (!is_kept)
            list_free(head);
    }

    List& operator=(List&& other) noexcept
    {
        std::swap(head, other.head);
        std::swap(count, other.count);
        return *this;
    }

    Node* head = nullptr;
    int count = 0;
    bool is_kept = false; // its own end leaves the nodes alone
};

} // namespace hxal
