#include "LinkedList.h"

#include "MacMemory.h"

void InitLinkedList(LinkedList* list, ListDisposeProc dispose)
{
    if (!list)
        return;
    list->head = nullptr;
    list->tail = nullptr;
    list->count = 0;
    list->dispose = dispose;
}

uint64_t GetNumberOfItems(const LinkedList* list)
{
    return list ? list->count : 0;
}

int16_t AddToTail(LinkedList* list, void* item)
{
    if (!list || !item)
        return paramErr;
    auto* node = static_cast<ListNode*>(NewPtr(sizeof(ListNode)));
    if (!node)
        return MemError();
    node->next = nullptr;
    node->data = item;
    if (list->tail)
        list->tail->next = node;
    else
        list->head = node;
    list->tail = node;
    list->count++;
    return noErr;
}

static void ClearList(LinkedList* list)
{
    list->head = nullptr;
    list->tail = nullptr;
    list->count = 0;
    list->dispose = nullptr;
}

LinkedList* InsertList(LinkedList* dest, LinkedList* src, ListNode* after)
{
    if (!dest || !src || !src->head || !src->tail || dest->dispose != src->dispose)
        return dest;
    if (!dest->head && !dest->tail)
    {
        dest->head = src->head;
        dest->tail = src->tail;
    }
    else if (!after)
    {
        src->tail->next = dest->head;
        dest->head = src->head;
    }
    else if (after == dest->tail)
    {
        after->next = src->head;
        dest->tail = src->tail;
    }
    else
    {
        ListNode* following = after->next;
        after->next = src->head;
        src->tail->next = following;
    }
    dest->count += src->count;
    ClearList(src);
    return dest;
}

void DestroyList(LinkedList* list)
{
    if (!list)
        return;
    for (ListNode* node = list->head; node;)
    {
        ListNode* next = node->next;
        if (list->dispose)
            list->dispose(node->data);
        DisposePtr(node);
        node = next;
    }
    ClearList(list);
}

void InitIterator(const LinkedList* list, ListIterator* iterator)
{
    if (list && iterator)
        *iterator = list->head;
}

// Running off the end is the caller's fault; it is not guarded.
void Next(ListIterator* iterator)
{
    if (iterator)
        *iterator = (*iterator)->next;
}

void* GetData(const ListNode* node)
{
    return node ? node->data : nullptr;
}
