#include "platform/base/Archive.h"

#include "platform/base/Collections.h"
#include "platform/base/MemFile.h"
#include "tests/unit/base/ExpectRaised.h"

#include <gtest/gtest.h>

#include <functional>
#include <memory>
#include <string>
#include <vector>

namespace {

/// A part of a drawing that may point to others.
class CArchiveNode : public CObject {
    DECLARE_SERIAL(CArchiveNode)

public:
    void Serialize(CArchive& archive) override {
        CObject::Serialize(archive);
        if (archive.IsStoring()) {
            archive << m_name << m_next;
        } else {
            m_schema = archive.GetObjectSchema();
            archive >> m_name >> m_next;
        }
    }

    CString m_name;
    CArchiveNode* m_next = nullptr;
    UINT m_schema = 0;
};
IMPLEMENT_SERIAL(CArchiveNode, CObject, 3)

class COtherArchiveNode : public CArchiveNode {
    DECLARE_SERIAL(COtherArchiveNode)
};
IMPLEMENT_SERIAL(COtherArchiveNode, CArchiveNode, VERSIONABLE_SCHEMA | 2)

std::string stored(const std::function<void(CArchive&)>& write) {
    CMemFile file;
    CArchive archive(&file, CArchive::store, 128);
    write(archive);
    archive.Close();
    std::string bytes(file.GetLength(), '\0');
    file.SeekToBegin();
    file.Read(bytes.data(), static_cast<UINT>(bytes.size()));
    return bytes;
}

void loadFrom(std::string bytes, const std::function<void(CArchive&)>& read) {
    CMemFile file(reinterpret_cast<BYTE*>(bytes.data()), static_cast<UINT>(bytes.size()));
    CArchive archive(&file, CArchive::load, 128);
    read(archive);
}

int causeOf(const std::string& bytes, const std::function<void(CArchive&)>& read) {
    try {
        loadFrom(bytes, read);
        return -1;
    } catch (CArchiveException* e) {
        const int cause = e->m_cause;
        e->Delete();
        return cause;
    }
}

void readNode(CArchive& archive) {
    CArchiveNode* node = nullptr;
    archive >> node;
    while (node && node->m_next != node) {
        delete std::exchange(node, node->m_next);
    }
    delete node;
}

std::string bytesOf(std::initializer_list<int> values) {
    return {values.begin(), values.end()};
}

} // namespace

TEST(Archive, NumbersHaveTheirOriginalSizes) {
    const auto size = [](auto value) { return stored([&](CArchive& archive) { archive << value; }).size(); };
    EXPECT_EQ(1u, size(true));
    EXPECT_EQ(1u, size('x'));
    EXPECT_EQ(2u, size(short{1}));
    EXPECT_EQ(4u, size(1));
    EXPECT_EQ(4u, size(1L));
    EXPECT_EQ(4u, size(1UL));
    EXPECT_EQ(8u, size(LONGLONG{1}));
    EXPECT_EQ(4u, size(1.0F));
    EXPECT_EQ(8u, size(1.0));
    EXPECT_EQ(bytesOf({0x78, 0x56, 0x34, 0x12}), stored([](CArchive& archive) { archive << DWORD{0x12345678}; }));
}

TEST(Archive, LoadsWhatItStored) {
    const std::string bytes = stored([](CArchive& archive) {
        archive << 'c' << BYTE{200} << short{-2} << WORD{60000} << -3 << 4000000000U << 5000000000L << -6L
                << 9000000000UL << LONGLONG{-5000000000} << ULONGLONG{1} << 1.5F << -2.25 << true << CPoint(-1, 2)
                << CSize(3, 4) << CRect(5, 6, 7, 8);
    });
    loadFrom(bytes, [](CArchive& archive) {
        const auto expect = [&]<typename Value>(Value expected) {
            Value value{};
            archive >> value;
            EXPECT_EQ(expected, value);
        };
        expect('c');
        expect(BYTE{200});
        expect(short{-2});
        expect(WORD{60000});
        expect(-3);
        expect(4000000000U);
        expect(2147483647L);
        expect(-6L);
        expect(4294967295UL);
        expect(LONGLONG{-5000000000});
        expect(ULONGLONG{1});
        expect(1.5F);
        expect(-2.25);
        expect(true);
        expect(CPoint(-1, 2));
        expect(CSize(3, 4));
        expect(CRect(5, 6, 7, 8));
    });
}

TEST(Archive, TextsHaveLengthsOfOneThreeOrSevenBytes) {
    for (const auto& [length, prefix] : {std::pair(0, 1), std::pair(254, 1), std::pair(255, 3), std::pair(65533, 3),
                                         std::pair(65534, 7), std::pair(300000, 7)}) {
        CString text('t', length);
        if (length > 1) {
            text.SetAt(1, '\0');
        }
        const std::string bytes = stored([&](CArchive& archive) { archive << text; });
        EXPECT_EQ(static_cast<std::size_t>(length + prefix), bytes.size());
        loadFrom(bytes, [&](CArchive& archive) {
            CString loaded = "before";
            archive >> loaded;
            EXPECT_EQ(text, loaded);
        });
    }
    EXPECT_EQ(bytesOf({3, 'a', 'b', 'c'}), stored([](CArchive& archive) { archive << CString("abc"); }));
    loadFrom(bytesOf({0xFF, 0xFE, 0xFF, 2, 0xE4, 0, 0xAC, 0x20}), [](CArchive& archive) {
        CString wide;
        archive >> wide;
        EXPECT_EQ("ä€", wide);
    });
}

TEST(Archive, CountsHaveTwoSixOrFourteenBytes) {
    for (const auto& [count, size] : {std::pair<DWORD_PTR, std::size_t>(0, 2),
                                      {0xFFFE, 2},
                                      {0xFFFF, 6},
                                      {0xFFFFFFFE, 6},
                                      {0xFFFFFFFF, 14},
                                      {0x123456789AB, 14}}) {
        const std::string bytes = stored([&](CArchive& archive) { archive.WriteCount(count); });
        EXPECT_EQ(size, bytes.size());
        loadFrom(bytes, [&](CArchive& archive) { EXPECT_EQ(count, archive.ReadCount()); });
    }
}

TEST(Archive, ObjectsAreStoredOnceAndMayPointInCircles) {
    CArchiveNode first;
    COtherArchiveNode second;
    first.m_name = "first";
    first.m_next = &second;
    second.m_name = "second";
    second.m_next = &first;
    const std::string bytes =
        stored([&](CArchive& archive) { archive << &first << &second << static_cast<CObject*>(nullptr); });
    EXPECT_EQ(bytes.find("second"), bytes.rfind("second"));
    loadFrom(bytes, [](CArchive& archive) {
        CArchiveNode* one = nullptr;
        CArchiveNode* two = nullptr;
        CArchiveNode before;
        CObject* none = &before;
        archive >> one >> two >> none;
        EXPECT_EQ(nullptr, none);
        const std::unique_ptr<CArchiveNode> ownOne(one);
        const std::unique_ptr<CArchiveNode> ownTwo(two);
        EXPECT_EQ(two, one->m_next);
        EXPECT_EQ(one, two->m_next);
        EXPECT_EQ(3u, one->m_schema);
        EXPECT_EQ(2u, two->m_schema);
        EXPECT_NE(nullptr, DYNAMIC_DOWNCAST(COtherArchiveNode, two));
    });
}

TEST(Archive, ObjectsWithoutPointersAreStoredBehindTheirClass) {
    CArchiveNode node;
    node.m_name = "inline";
    const std::string bytes = stored([&](CArchive& archive) {
        archive.SerializeClass(node.GetRuntimeClass());
        node.Serialize(archive);
    });
    loadFrom(bytes, [](CArchive& archive) {
        CArchiveNode loaded;
        archive.SerializeClass(loaded.GetRuntimeClass());
        archive.SetObjectSchema(7); // as a Serialize function that reads another class's data does
        loaded.Serialize(archive);
        EXPECT_EQ("inline", loaded.m_name);
        EXPECT_EQ(7u, loaded.m_schema);
        EXPECT_EQ(0xFFFFFFFFu, archive.GetObjectSchema()) << "a schema is told once";
    });
    const auto asAnother = [](CArchive& archive) { archive.SerializeClass(RUNTIME_CLASS(COtherArchiveNode)); };
    EXPECT_EQ(CArchiveException::badClass, causeOf(bytes, asAnother));
}

TEST(Archive, TagsKeepTheirFormat) {
    CArchiveNode node;
    const std::string bytes = stored([&](CArchive& archive) { archive << &node << &node; });
    EXPECT_EQ(bytesOf({0xFF, 0xFF, 3, 0, 12, 0}) + "CArchiveNode" + bytesOf({0, 0, 0, 2, 0}), bytes);
}

TEST(Archive, NumbersBeyondTheSmallTagStillFindTheirObjects) {
    constexpr int count = 40000;
    std::vector<CArchiveNode> nodes(count);
    const std::string bytes = stored([&](CArchive& archive) {
        for (const CArchiveNode& node : nodes) {
            archive << &node;
        }
        archive << &nodes[count - 1];
    });
    loadFrom(bytes, [](CArchive& archive) {
        CObArray loaded;
        for (int i = 0; i <= count; ++i) {
            loaded.Add(archive.ReadObject(RUNTIME_CLASS(CArchiveNode)));
        }
        EXPECT_EQ(loaded[count - 1], loaded[count]);
        for (int i = 0; i < count; ++i) {
            delete loaded[i];
        }
    });
}

TEST(Archive, CollectionsAreStoredAsWhole) {
    CStringArray names;
    CDWordArray numbers;
    CArray<CPoint> points;
    CMapStringToString map;
    for (int i = 0; i < 3000; ++i) {
        names.Add("name");
        numbers.Add(static_cast<DWORD>(i));
        points.Add(CPoint(i, -i));
    }
    map["key"] = "value";
    const std::string bytes = stored([&](CArchive& archive) {
        names.Serialize(archive);
        numbers.Serialize(archive);
        points.Serialize(archive);
        map.Serialize(archive);
    });
    loadFrom(bytes, [](CArchive& archive) {
        CStringArray loadedNames;
        loadedNames.Add("gone");
        loadedNames.Serialize(archive);
        CDWordArray loadedNumbers;
        loadedNumbers.Serialize(archive);
        CArray<CPoint> loadedPoints;
        loadedPoints.Serialize(archive);
        CMapStringToString loadedMap;
        loadedMap.Serialize(archive);
        ASSERT_EQ(3000, loadedNames.GetSize());
        EXPECT_EQ("name", loadedNames[0]);
        EXPECT_EQ(2999u, loadedNumbers[2999]);
        EXPECT_EQ(CPoint(2999, -2999), loadedPoints[2999]);
        EXPECT_EQ("value", loadedMap["key"]);
    });
    struct Corner { // plain data, though not by the language's rules
        int x = 0;
        Corner() = default;
        Corner(const Corner& other) : x(other.x) {}
        Corner& operator=(const Corner& other) = default;
    };
    CArray<Corner> corners;
    corners.SetSize(2);
    corners[1].x = 7;
    const std::string cornerBytes = stored([&](CArchive& archive) { corners.Serialize(archive); });
    EXPECT_EQ(2 + 2 * sizeof(Corner), cornerBytes.size());
    corners.RemoveAll();
    loadFrom(cornerBytes, [&](CArchive& archive) { corners.Serialize(archive); });
    EXPECT_EQ(7, corners.GetAt(1).x);
    CPtrArray pointers;
    EXPECT_THROW(stored([&](CArchive& archive) { pointers.Add(&pointers), pointers.Serialize(archive); }),
                 CNotSupportedException*);
}

TEST(Archive, EveryTruncationIsNoticed) {
    CArchiveNode first;
    CArchiveNode second;
    first.m_next = &second;
    second.m_name = "second";
    const std::string bytes = stored([&](CArchive& archive) { archive << &first; });
    for (std::size_t length = 0; length < bytes.size(); ++length) {
        EXPECT_EQ(CArchiveException::endOfFile, causeOf(bytes.substr(0, length), readNode)) << length;
    }
    EXPECT_EQ(-1, causeOf(bytes, readNode));
}

TEST(Archive, DamageIsRefusedWithItsCause) {
    const auto newClass = [](int schema, const std::string& name) {
        return bytesOf({0xFF, 0xFF, schema, 0, static_cast<int>(name.size()), 0}) + name;
    };
    const std::string tail = bytesOf({0, 0, 0});
    EXPECT_EQ(CArchiveException::badSchema, causeOf(newClass(4, "CArchiveNode") + tail, readNode));
    EXPECT_EQ(-1, causeOf(newClass(1, "COtherArchiveNode") + tail, readNode));
    EXPECT_EQ(CArchiveException::badClass, causeOf(newClass(0, "CNoSuchClass") + tail, readNode));
    EXPECT_EQ(CArchiveException::badClass, causeOf(newClass(0, "CStringArray") + tail, readNode));
    EXPECT_EQ(CArchiveException::badClass, causeOf(newClass(0xFF, "CMemFile") + tail, readNode));
    EXPECT_EQ(CArchiveException::badClass, causeOf(bytesOf({0xFF, 0xFF, 0, 0, 0xFF, 0xFF}), readNode));
    // Numbers of objects and classes that do not exist, or are of the other kind.
    EXPECT_EQ(CArchiveException::badIndex, causeOf(bytesOf({5, 0}), readNode));
    EXPECT_EQ(CArchiveException::badIndex, causeOf(bytesOf({1, 0x80}), readNode));
    EXPECT_EQ(CArchiveException::badIndex, causeOf(bytesOf({0xFF, 0x7F, 0xFF, 0xFF, 0xFF, 0xFF}), readNode));
    EXPECT_EQ(CArchiveException::badIndex, causeOf(newClass(3, "CArchiveNode") + bytesOf({0, 1, 0}), readNode));
    EXPECT_EQ(CArchiveException::badIndex, causeOf(newClass(3, "CArchiveNode") + bytesOf({0, 2, 0x80}), readNode));
}

TEST(Archive, PromisedSizesTakeNoMemory) {
    const auto readText = [](CArchive& archive) {
        CString text;
        archive >> text;
    };
    EXPECT_EQ(CArchiveException::endOfFile, causeOf(bytesOf({0xFF, 0xFF, 0xFF, 0xFF, 0xFF, 0xFF, 0x7F}), readText));
    EXPECT_EQ(CArchiveException::genericException, causeOf(bytesOf({0xFF, 0xFF, 0xFF, 0, 0, 0, 0x80}), readText));
    const auto readArray = [](CArchive& archive) {
        CDWordArray array;
        array.Serialize(archive);
    };
    EXPECT_EQ(CArchiveException::endOfFile, causeOf(bytesOf({0xFF, 0xFF, 0xFE, 0xFF, 0xFF, 0xFF, 1, 2, 3}), readArray));
}

TEST(Archive, NestingWithoutEndIsRefused) {
    std::string bytes = bytesOf({0xFF, 0xFF, 3, 0, 12, 0}) + "CArchiveNode" + bytesOf({0});
    for (int i = 0; i < 100000; ++i) {
        bytes += bytesOf({1, 0x80, 0});
    }
    EXPECT_EQ(CArchiveException::genericException, causeOf(bytes, readNode));
}

TEST(Archive, RefusesTheWrongDirection) {
    CMemFile file;
    CArchive loading(&file, CArchive::load);
    expectRaised<CArchiveException>([&] { loading << 1; });
    CArchive storing(&file, CArchive::store);
    int number = 0;
    expectRaised<CArchiveException>([&] { storing >> number; });
    storing.Close();
    expectRaised<CArchiveException>([&] { storing << 1; });
    EXPECT_THROW(stored([&](CArchive& archive) { archive << &file; }), CNotSupportedException*);
}

TEST(Archive, LeavesTheFileBehindWhatItRead) {
    std::string bytes = "0123456789";
    CMemFile file(reinterpret_cast<BYTE*>(bytes.data()), 10);
    {
        CArchive archive(&file, CArchive::load);
        char first[3];
        archive.EnsureRead(first, 3);
    }
    EXPECT_EQ(3u, file.GetPosition());
}

TEST(Archive, ReadsLines) {
    loadFrom("one\r\ntwo\nlast", [](CArchive& archive) {
        CString line;
        CString all;
        while (archive.ReadString(line)) {
            all += "<" + line + ">";
        }
        EXPECT_EQ("<one><two><last>", all);
    });
}

TEST(Archive, ReportsAFullDiskWhenClosing) {
    CFile full("/dev/full", CFile::modeWrite);
    CArchive archive(&full, CArchive::store);
    archive << 1;
    expectRaised<CFileException>([&] { archive.Close(); });
    archive.Abort();
}
