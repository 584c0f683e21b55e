#pragma once
// A small singly linked list of untyped items, exported by the module with
// C linkage for hosts. The list owns its nodes; items go to the dispose
// function when the list is destroyed.
#include <cstdint>
#include "HFExport.h"

typedef void (*ListDisposeProc)(void* item);

struct ListNode
{
    ListNode* next; // first word: appending treats an empty list's head like a node's next
    void* data;
};

struct LinkedList
{
    ListNode* head;
    ListNode* tail;
    uint64_t count;
    ListDisposeProc dispose;
};

typedef ListNode* ListIterator;

HF_MODULE_EXPORT void InitLinkedList(LinkedList* list, ListDisposeProc dispose);
HF_MODULE_EXPORT uint64_t GetNumberOfItems(const LinkedList* list);
HF_MODULE_EXPORT int16_t AddToTail(LinkedList* list, void* item);
HF_MODULE_EXPORT LinkedList* InsertList(LinkedList* dest, LinkedList* src, ListNode* after);
HF_MODULE_EXPORT void DestroyList(LinkedList* list);
HF_MODULE_EXPORT void InitIterator(const LinkedList* list, ListIterator* iterator);
HF_MODULE_EXPORT void Next(ListIterator* iterator);
HF_MODULE_EXPORT void* GetData(const ListNode* node);
