#include "model/dor_list.h"

#include <cstdlib>
#include <new>

CDorList::CDorList(int nodesPerBlock)
    : head(nullptr), tail(nullptr), count(0), freeList(nullptr), blocks(nullptr),
      blockSize(nodesPerBlock < 1 ? 1 : nodesPerBlock)
{
}

CDorList::CDorList(const CDorList& other) : CDorList(other.blockSize)
{
    for (Node* n = other.head; n; n = n->next)
        AddTail(n->data);
}

CDorList& CDorList::operator=(const CDorList& other)
{
    if (this != &other) {
        RemoveAll();
        blockSize = other.blockSize;
        for (Node* n = other.head; n; n = n->next)
            AddTail(n->data);
    }
    return *this;
}

CDorList::~CDorList() { RemoveAll(); }

CDorList::Node* CDorList::TakeFreeNode()
{
    if (!freeList) {
        void* block = std::malloc(sizeof(void*) + sizeof(Node) * static_cast<size_t>(blockSize));
        if (!block)
            throw std::bad_alloc();
        *static_cast<void**>(block) = blocks;
        blocks = block;
        Node* nodes = reinterpret_cast<Node*>(static_cast<void**>(block) + 1);
        for (int i = blockSize - 1; i >= 0; --i) {  // reverse order: node 0 is handed out first
            nodes[i].next = freeList;
            freeList = &nodes[i];
        }
    }
    Node* node = freeList;
    freeList = node->next;
    return node;
}

_DorPosition* CDorList::AddTail(void* element)
{
    Node* node = TakeFreeNode();
    node->data = element;
    node->next = nullptr;
    node->prev = tail;
    if (tail)
        tail->next = node;
    else
        head = node;
    tail = node;
    ++count;
    return ToPosition(node);
}

_DorPosition* CDorList::AddHead(void* element)
{
    Node* node = TakeFreeNode();
    node->data = element;
    node->prev = nullptr;
    node->next = head;
    if (head)
        head->prev = node;
    else
        tail = node;
    head = node;
    ++count;
    return ToPosition(node);
}

void CDorList::RemoveAt(_DorPosition* position)
{
    Node* node = ToNode(position);
    if (!node)
        return;
    (node->prev ? node->prev->next : head) = node->next;
    (node->next ? node->next->prev : tail) = node->prev;
    node->data = nullptr;
    node->prev = nullptr;
    node->next = freeList;
    freeList = node;
    if (--count == 0)
        FreeBlocks();
}

void CDorList::RemoveAll() { FreeBlocks(); }

void CDorList::FreeBlocks()
{
    while (blocks) {
        void* next = *static_cast<void**>(blocks);
        std::free(blocks);
        blocks = next;
    }
    head = tail = freeList = nullptr;
    count = 0;
}

void CDorList::MoveToHead(_DorPosition*& position)
{
    if (!position)
        return;
    void* element = GetAt(position);
    RemoveAt(position);
    position = AddHead(element);
}

void CDorList::MoveToTail(_DorPosition*& position)
{
    if (!position)
        return;
    void* element = GetAt(position);
    RemoveAt(position);
    position = AddTail(element);
}
