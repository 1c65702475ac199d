#include "platform/base/Collections.h"

#include <gtest/gtest.h>

#include <map>

namespace {

template <typename Collection>
CString joined(const Collection& list) {
    CString result;
    for (POSITION at = list.GetHeadPosition(); at;) {
        result += list.GetNext(at) + ",";
    }
    return result;
}

CString joined(const CStringArray& array) {
    CString result;
    for (const CString& element : array) {
        result += element + ",";
    }
    return result;
}

template <typename Function>
void expectInvalid(Function function) {
    EXPECT_THROW(function(), CInvalidArgException*);
}

struct Shape {
    int id;
};

} // namespace

TEST(Array, GrowsAndShrinksAnywhere) {
    CStringArray array;
    EXPECT_EQ(-1, array.GetUpperBound());
    EXPECT_EQ(0, array.Add("a"));
    array.SetAtGrow(2, "c");
    EXPECT_EQ("a,,c,", joined(array));
    array.InsertAt(1, "x", 2);
    EXPECT_EQ("a,x,x,,c,", joined(array));
    array.InsertAt(6, "z");
    EXPECT_EQ("a,x,x,,c,,z,", joined(array));
    array.RemoveAt(1, 3);
    EXPECT_EQ("a,c,,z,", joined(array));
    array.SetSize(2);
    EXPECT_EQ("a,c,", joined(array));
    array.RemoveAll();
    EXPECT_TRUE(array.IsEmpty());
    EXPECT_EQ(nullptr, array.GetData());
}

TEST(Array, ElementsAreChangedInPlace) {
    CStringArray array;
    array.Add("a");
    array.ElementAt(0) += "b";
    const CStringArray& fixed = array;
    EXPECT_EQ("ab", fixed.ElementAt(0));
    expectInvalid([&] { array.ElementAt(1) = "c"; });
}

TEST(Array, TakesItsOwnElementsAsArguments) {
    CStringArray array;
    array.Add("a");
    for (int i = 0; i < 20; ++i) {
        array.Add(array[0]);
    }
    array.InsertAt(0, array[20], 3);
    array.SetAtGrow(100, array[0]);
    EXPECT_EQ("a", array[100]);
    array.SetSize(2);
    array.Append(array);
    array.InsertAt(1, &array);
    EXPECT_EQ("a,a,a,a,a,a,a,a,", joined(array));
    array.Copy(array);
    EXPECT_EQ(8, array.GetSize());
}

TEST(Array, RefusesIndicesOutside) {
    CDWordArray array;
    array.Add(1);
    expectInvalid([&] { array[1] = 2; });
    expectInvalid([&] { array.SetAt(-1, 2); });
    expectInvalid([&] { array.RemoveAt(0, 2); });
    expectInvalid([&] { array.RemoveAt(1, -1); });
    expectInvalid([&] { array.SetSize(-1); });
    expectInvalid([&] { array.SetAtGrow(-1, 2); });
    EXPECT_THROW(array.SetSize(INTPTR_MAX), CMemoryException*);
    EXPECT_THROW(array.SetAtGrow(INTPTR_MAX, 1), CMemoryException*);
    EXPECT_EQ(1, array.GetSize());
}

TEST(List, LinksAtBothEndsAndBetween) {
    CStringList list;
    list.AddTail("b");
    list.AddHead("a");
    const POSITION d = list.AddTail("d");
    list.InsertBefore(d, "c");
    list.InsertAfter(d, "e");
    EXPECT_EQ("a,b,c,d,e,", joined(list));
    list.RemoveAt(d);
    EXPECT_EQ("a", list.RemoveHead());
    EXPECT_EQ("e", list.RemoveTail());
    EXPECT_EQ("b,c,", joined(list));
    list.AddTail(&list);
    list.AddHead(&list);
    EXPECT_EQ("b,c,b,c,b,c,b,c,", joined(list));
    CString backwards;
    for (POSITION at = list.GetTailPosition(); at;) {
        backwards += list.GetPrev(at);
    }
    EXPECT_EQ("cbcbcbcb", backwards);
}

TEST(List, Finds) {
    CStringList list;
    for (const char* element : {"a", "b", "a"}) {
        list.AddTail(element);
    }
    const POSITION first = list.Find("a");
    EXPECT_EQ(list.GetHeadPosition(), first);
    EXPECT_EQ(list.GetTailPosition(), list.Find("a", first));
    EXPECT_EQ(nullptr, list.Find("c"));
    EXPECT_EQ("b", list.GetAt(list.FindIndex(1)));
    EXPECT_EQ(nullptr, list.FindIndex(3));
    EXPECT_EQ(nullptr, list.FindIndex(-1));
}

TEST(List, RefusesWhatIsNotThere) {
    CPtrList list;
    expectInvalid([&] { list.GetHead(); });
    expectInvalid([&] { list.RemoveTail(); });
    expectInvalid([&] { list.RemoveAt(nullptr); });
    POSITION none = nullptr;
    expectInvalid([&] { list.GetNext(none); });
}

TEST(List, ElementsMayBeRemovedWhileIterating) {
    CList<int, int> list;
    for (int i = 0; i < 10; ++i) {
        list.AddTail(i);
    }
    for (POSITION at = list.GetHeadPosition(); at;) {
        const POSITION current = at;
        if (list.GetNext(at) % 2) {
            list.RemoveAt(current);
        }
    }
    EXPECT_EQ(5, list.GetCount());
    EXPECT_EQ(8, list.GetTail());
}

TEST(Map, SetsFindsAndRemoves) {
    CMapStringToString map;
    map.SetAt("one", "1");
    map["two"] = "2";
    map["one"] = "uno";
    CString value = "unchanged";
    EXPECT_FALSE(map.Lookup("three", value));
    EXPECT_EQ("unchanged", value);
    EXPECT_TRUE(map.Lookup(CString("one"), value));
    EXPECT_EQ("uno", value);
    EXPECT_TRUE(map.RemoveKey("one"));
    EXPECT_FALSE(map.RemoveKey("one"));
    EXPECT_EQ(1, map.GetCount());
}

TEST(Map, KeepsItsElementsWhenRoomIsMadeForMore) {
    CMapStringToString map;
    map["one"] = "1";
    map.InitHashTable(1009);
    map.InitHashTable(7, FALSE);
    CString value;
    EXPECT_TRUE(map.Lookup("one", value));
    EXPECT_EQ("1", value);
}

TEST(Map, IteratesOverAllWhileCurrentOnesAreRemoved) {
    CMapPtrToWord map(10);
    std::map<void*, WORD> expected;
    for (std::uintptr_t i = 1; i <= 1000; ++i) {
        map.SetAt(reinterpret_cast<void*>(i * 16), static_cast<WORD>(i));
        expected[reinterpret_cast<void*>(i * 16)] = static_cast<WORD>(i);
    }
    std::map<void*, WORD> seen;
    for (POSITION at = map.GetStartPosition(); at;) {
        void* key = nullptr;
        WORD value = 0;
        map.GetNextAssoc(at, key, value);
        seen[key] = value;
        map.RemoveKey(key);
    }
    EXPECT_EQ(expected, seen);
    EXPECT_TRUE(map.IsEmpty());
    EXPECT_EQ(nullptr, map.GetStartPosition());
}

TEST(TypedCollections, KnowWhatTheirPointersPointTo) {
    Shape first{1};
    Shape second{2};
    CTypedPtrArray<CPtrArray, Shape*> array;
    array.Add(&first);
    array.InsertAt(0, &second);
    EXPECT_EQ(2, array[0]->id);
    CTypedPtrList<CPtrList, Shape*> list;
    list.AddHead(&first);
    list.AddTail(&second);
    int sum = 0;
    for (POSITION at = list.GetHeadPosition(); at;) {
        sum = sum * 10 + list.GetNext(at)->id;
    }
    EXPECT_EQ(12, sum);
    EXPECT_EQ(list.GetTailPosition(), list.Find(&second));
}
