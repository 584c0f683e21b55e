// The list the module exports to hosts, and the two numberings of the image
// position; cases in tests/data/frame/linked-list-inserts.txt, image-positions.txt.
#include <sstream>
#include <vector>

#include <gtest/gtest.h>

#include "CaseTable.h"
#include "ImagePosition.h"
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
int values[8] = {0, 1, 2, 3, 4, 5, 6, 7};

// "items (count, tail, dispose procedure)", walked with the iterator.
std::string Describe(const LinkedList& list)
{
    std::ostringstream text;
    ListIterator it = nullptr;
    for (InitIterator(&list, &it); it; Next(&it))
        text << *static_cast<int*>(GetData(it)) << " ";
    text << "(" << GetNumberOfItems(&list) << ", ";
    text << (list.tail ? std::to_string(*static_cast<int*>(GetData(list.tail))) : "-") << ", ";
    text << (list.dispose == RecordDispose ? "same" : list.dispose ? "other" : "none") << ")";
    return text.str();
}

void Fill(LinkedList& list, ListDisposeProc dispose, const std::string& items)
{
    InitLinkedList(&list, dispose);
    std::istringstream in(items);
    for (int i; in >> i;)
        ASSERT_EQ(AddToTail(&list, &values[i]), noErr);
}
} // namespace

TEST(LinkedList, InsertListAsTabled)
{
    const auto cases = testkit::ReadCaseTable("frame/linked-list-inserts.txt");
    ASSERT_EQ(cases.size(), 6u);
    for (const auto& c : cases)
    {
        LinkedList a{}, b{};
        Fill(a, RecordDispose, c[0]);
        Fill(b, c[2] == "same" ? RecordDispose : OtherDispose, c[1]);
        ListNode* after = nullptr;
        for (int i = c[3] == "-" ? -1 : std::stoi(c[3]), n = 0; n <= i; ++n)
            after = n ? after->next : a.head;
        EXPECT_EQ(InsertList(&a, &b, after), &a);
        EXPECT_EQ(Describe(a) + " | " + Describe(b), c[4] + " | " + c[5]) << c[6];
        DestroyList(&a);
        DestroyList(&b);
    }
}

TEST(LinkedList, AppendDestroyAndBadArguments)
{
    disposed.clear();
    LinkedList a{}, b{};
    Fill(a, RecordDispose, "3 1 2");
    EXPECT_EQ(AddToTail(&a, nullptr), paramErr);
    EXPECT_EQ(AddToTail(nullptr, &values[2]), paramErr);
    posix::SetAllocationFailuresForTesting(0, 1);
    EXPECT_EQ(AddToTail(&a, &values[4]), memFullErr);
    posix::SetAllocationFailuresForTesting(0, 0);
    EXPECT_EQ(Describe(a), "3 1 2 (3, 2, same)");
    EXPECT_EQ(InsertList(nullptr, &b, nullptr), nullptr);
    EXPECT_EQ(InsertList(&a, nullptr, nullptr), &a);

    ListIterator it = a.head;
    InitIterator(nullptr, &it); // no list: the iterator is left alone
    EXPECT_EQ(it, a.head);
    InitIterator(&a, nullptr);
    Next(nullptr);
    EXPECT_EQ(GetNumberOfItems(nullptr), 0u);
    EXPECT_EQ(GetData(nullptr), nullptr);

    DestroyList(&a); // each item disposed in order, the record cleared
    EXPECT_EQ(disposed, (std::vector<int>{3, 1, 2}));
    EXPECT_TRUE(a.head == nullptr && Describe(a) == "(0, -, none)");
    DestroyList(nullptr);
}

TEST(ImagePositions, BothNumberings)
{
    const auto cases = testkit::ReadCaseTable("frame/image-positions.txt");
    ASSERT_EQ(cases.size(), 12u);
    for (const auto& c : cases)
    {
        const int n = std::stoi(c[1]),
                  converted = c[0] == "to-panel"
                                  ? int(ConvertFromImgPos(static_cast<FilterImgPosition_t>(n)))
                                  : int(ConvertToImgPos(static_cast<ImagePosition_t>(n)));
        EXPECT_EQ(converted, std::stoi(c[2])) << c[3];
    }
}
