#include <vector>

#include <gtest/gtest.h>

#include "LinkedList.h"
#include "MacMemory.h"
#include "posix/AllocationFailures.h"

namespace
{
std::vector<int> disposed;
void RecordDispose(void* item)
{
    disposed.push_back(*static_cast<int*>(item));
}
void OtherDispose(void*) {}

std::vector<int> Walk(const LinkedList& list)
{
    std::vector<int> items;
    ListIterator it = nullptr;
    InitIterator(&list, &it);
    for (; it; Next(&it))
        items.push_back(*static_cast<int*>(GetData(it)));
    return items;
}

struct Lists : ::testing::Test
{
    int values[8] = {0, 1, 2, 3, 4, 5, 6, 7};
    LinkedList a{}, b{};
    void SetUp() override
    {
        disposed.clear();
        InitLinkedList(&a, RecordDispose);
        InitLinkedList(&b, RecordDispose);
    }
    void TearDown() override
    {
        DestroyList(&a);
        DestroyList(&b);
    }
    void Fill(LinkedList& list, std::initializer_list<int> indices)
    {
        for (int i : indices)
            ASSERT_EQ(AddToTail(&list, &values[i]), noErr);
    }
};
} // namespace

TEST_F(Lists, AppendKeepsOrderAndCount)
{
    Fill(a, {1, 2, 3});
    EXPECT_EQ(GetNumberOfItems(&a), 3u);
    EXPECT_EQ(Walk(a), (std::vector<int>{1, 2, 3}));
    EXPECT_EQ(GetNumberOfItems(nullptr), 0u);
    EXPECT_EQ(GetData(nullptr), nullptr);
}

TEST_F(Lists, NullArgumentsAreParameterErrors)
{
    Fill(a, {1});
    EXPECT_EQ(AddToTail(&a, nullptr), paramErr);
    EXPECT_EQ(AddToTail(nullptr, &values[2]), paramErr);
    EXPECT_EQ(Walk(a), (std::vector<int>{1}));
}

TEST_F(Lists, AllocatorFailureReportsItsCode)
{
    Fill(a, {1});
    posix::SetAllocationFailuresForTesting(0, 1);
    EXPECT_EQ(AddToTail(&a, &values[2]), memFullErr);
    posix::SetAllocationFailuresForTesting(0, 0);
    EXPECT_EQ(GetNumberOfItems(&a), 1u);
    EXPECT_EQ(Walk(a), (std::vector<int>{1}));
}

TEST_F(Lists, DestroyDisposesEachItemInOrderAndClearsTheRecord)
{
    Fill(a, {3, 1, 2});
    DestroyList(&a);
    EXPECT_EQ(disposed, (std::vector<int>{3, 1, 2}));
    EXPECT_EQ(a.head, nullptr);
    EXPECT_EQ(a.tail, nullptr);
    EXPECT_EQ(a.count, 0u);
    EXPECT_EQ(a.dispose, nullptr);
    DestroyList(nullptr);
}

TEST_F(Lists, InsertIntoEmptyMovesEverything)
{
    Fill(b, {1, 2});
    EXPECT_EQ(InsertList(&a, &b, nullptr), &a);
    EXPECT_EQ(GetNumberOfItems(&a), 2u);
    EXPECT_EQ(Walk(a), (std::vector<int>{1, 2}));
    EXPECT_EQ(b.count, 0u);
    EXPECT_EQ(b.head, nullptr);
    EXPECT_EQ(b.dispose, nullptr);
}

TEST_F(Lists, InsertAtFrontMiddleAndEnd)
{
    Fill(a, {1, 2, 3});
    Fill(b, {6, 7});
    InsertList(&a, &b, nullptr);
    EXPECT_EQ(Walk(a), (std::vector<int>{6, 7, 1, 2, 3}));

    InitLinkedList(&b, RecordDispose);
    Fill(b, {4, 5});
    InsertList(&a, &b, a.tail);
    EXPECT_EQ(Walk(a), (std::vector<int>{6, 7, 1, 2, 3, 4, 5}));
    EXPECT_EQ(*static_cast<int*>(GetData(a.tail)), 5);

    InitLinkedList(&b, RecordDispose);
    Fill(b, {0});
    ListNode* second = a.head->next; // holds 7
    InsertList(&a, &b, second);
    EXPECT_EQ(Walk(a), (std::vector<int>{6, 7, 0, 1, 2, 3, 4, 5}));
    EXPECT_EQ(GetNumberOfItems(&a), 8u);
}

TEST_F(Lists, InsertRefusesMismatchedOrEmptySources)
{
    Fill(a, {1});
    LinkedList other{};
    InitLinkedList(&other, OtherDispose);
    AddToTail(&other, &values[2]);
    EXPECT_EQ(InsertList(&a, &other, nullptr), &a);
    EXPECT_EQ(Walk(a), (std::vector<int>{1}));
    EXPECT_EQ(GetNumberOfItems(&other), 1u);
    DestroyList(&other);

    EXPECT_EQ(InsertList(&a, &b, nullptr), &a); // empty source
    EXPECT_EQ(GetNumberOfItems(&a), 1u);
    EXPECT_EQ(InsertList(nullptr, &b, nullptr), nullptr);
    EXPECT_EQ(InsertList(&a, nullptr, nullptr), &a);
}
