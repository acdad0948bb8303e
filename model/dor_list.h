#pragma once
// CDorList: a doubly linked list of element pointers whose node addresses are the library's
// entity handles (_DorPosition*). Nodes come from blocks of blockSize nodes; a removed node goes
// to the front of a free chain and is reused first, so handles of other elements never move.
// When the last element is removed every block is freed.
#include "../model/dor_types.h"
#include "../model/export.h"

class KARVEL_API CDorList {
public:
    struct Node {
        Node* next;
        Node* prev;
        void* data;
    };

    Node* head;
    Node* tail;
    int count;
    Node* freeList;
    void* blocks;  // chain of node blocks; each block starts with the pointer to the next
    int blockSize;

    explicit CDorList(int nodesPerBlock = 10);
    CDorList(const CDorList& other);
    CDorList& operator=(const CDorList& other);
    ~CDorList();

    _DorPosition* AddTail(void* element);
    _DorPosition* AddHead(void* element);
    // Unlinks the node and returns it to the free chain; a null handle does nothing.
    void RemoveAt(_DorPosition* position);
    void RemoveAll();
    // Re-inserts the element at the head or tail and writes its (possibly new) handle back.
    void MoveToHead(_DorPosition*& position);
    void MoveToTail(_DorPosition*& position);

    int GetCount() const { return count; }
    _DorPosition* GetHeadPosition() const { return ToPosition(head); }
    _DorPosition* GetTailPosition() const { return ToPosition(tail); }
    static _DorPosition* GetNextPosition(_DorPosition* position) { return ToPosition(ToNode(position)->next); }
    static void* GetAt(_DorPosition* position) { return ToNode(position)->data; }

    static Node* ToNode(_DorPosition* position) { return reinterpret_cast<Node*>(position); }
    static _DorPosition* ToPosition(Node* node) { return reinterpret_cast<_DorPosition*>(node); }

private:
    Node* TakeFreeNode();
    void FreeBlocks();
};
