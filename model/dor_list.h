#pragma once
/// @file
/// CDorList, the list behind the modeller's entity handles.
#include "../model/dor_types.h"
#include "../model/export.h"

/// A doubly linked list of element pointers whose node addresses are the library's entity handles
/// (_DorPosition*). Nodes come from blocks of blockSize nodes; a removed node goes to the front of
/// a free chain and is reused first, so handles of other elements never move. When the last
/// element is removed every block is freed. The list does not own the elements it points to.
class KARVEL_API CDorList {
public:
    /// One node; its address is the element's handle.
    struct Node {
        Node* next;  ///< Towards the tail; null at the tail.
        Node* prev;  ///< Towards the head; null at the head.
        void* data;  ///< The element.
    };

    Node* head;      ///< First node, or null.
    Node* tail;      ///< Last node, or null.
    int count;       ///< Elements in the list.
    Node* freeList;  ///< Nodes ready for reuse, most recently freed first.
    void* blocks;    ///< Chain of node blocks; each block starts with the pointer to the next.
    int blockSize;   ///< Nodes per block.

    /// An empty list that allocates nodes nodesPerBlock at a time.
    explicit CDorList(int nodesPerBlock = 10);
    /// A list of the same element pointers, in the same order, in nodes of its own.
    CDorList(const CDorList& other);
    /// Replaces the list with other's element pointers, in order, in nodes of its own.
    CDorList& operator=(const CDorList& other);
    /// Frees every node block (not the elements).
    ~CDorList();

    /// Appends element and returns its handle.
    _DorPosition* AddTail(void* element);
    /// Prepends element and returns its handle.
    _DorPosition* AddHead(void* element);
    /// Unlinks the node and returns it to the free chain; a null handle does nothing.
    void RemoveAt(_DorPosition* position);
    /// Empties the list and frees every node block.
    void RemoveAll();
    /// Re-inserts the element at the head and writes its (possibly new) handle back: when it was
    /// the only element the blocks are freed and the node comes from a fresh block.
    void MoveToHead(_DorPosition*& position);
    /// The same at the tail.
    void MoveToTail(_DorPosition*& position);

    /// Elements in the list.
    int GetCount() const { return count; }
    /// The first element's handle, or null.
    _DorPosition* GetHeadPosition() const { return ToPosition(head); }
    /// The last element's handle, or null.
    _DorPosition* GetTailPosition() const { return ToPosition(tail); }
    /// The handle after position (not null), or null at the tail.
    static _DorPosition* GetNextPosition(_DorPosition* position) { return ToPosition(ToNode(position)->next); }
    /// The element at position (not null).
    static void* GetAt(_DorPosition* position) { return ToNode(position)->data; }

    /// The node behind a handle.
    static Node* ToNode(_DorPosition* position) { return reinterpret_cast<Node*>(position); }
    /// The handle of a node.
    static _DorPosition* ToPosition(Node* node) { return reinterpret_cast<_DorPosition*>(node); }

private:
    Node* TakeFreeNode();
    void FreeBlocks();
};
