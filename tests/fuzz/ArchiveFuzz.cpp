// Loads numbers, texts, collections and objects that point to each other from an archive of any bytes. Whatever they
// are, loading ends with a value or with an exception of the framework.
#include "platform/base/Archive.h"

#include "platform/base/Collections.h"
#include "platform/base/MemFile.h"

#include <cstdint>
#include <set>
#include <vector>

namespace {

/// Part of a graph. The parts may point in circles, so all of them are kept in a list of their own.
class CFuzzNode : public CObject {
    DECLARE_SERIAL(CFuzzNode)

public:
    CFuzzNode() {
        all().insert(this);
    }
    ~CFuzzNode() override {
        all().erase(this);
    }
    void Serialize(CArchive& archive) override {
        CObject::Serialize(archive);
        archive >> m_name >> m_first >> m_second;
        m_numbers.Serialize(archive);
    }
    static std::set<CFuzzNode*>& all() {
        static std::set<CFuzzNode*> nodes;
        return nodes;
    }

private:
    CString m_name;
    CFuzzNode* m_first = nullptr;
    CFuzzNode* m_second = nullptr;
    CWordArray m_numbers;
};
IMPLEMENT_SERIAL(CFuzzNode, CObject, VERSIONABLE_SCHEMA | 1)

void load(CArchive& archive) {
    BYTE kind = 0;
    CStringArray texts;
    CMapStringToString map;
    CFuzzNode* node = nullptr;
    CString line;
    for (;;) {
        archive >> kind;
        switch (kind % 4) {
        case 0:
            archive >> node;
            break;
        case 1:
            texts.Serialize(archive);
            break;
        case 2:
            map.Serialize(archive);
            break;
        default:
            archive.ReadString(line);
        }
    }
}

} // namespace

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size) {
    std::vector<BYTE> bytes(data, data + size);
    CMemFile file(bytes.data(), static_cast<UINT>(size));
    CArchive archive(&file, CArchive::load, 128);
    try {
        load(archive);
    } catch (CException* e) {
        e->Delete();
    }
    while (!CFuzzNode::all().empty()) {
        delete *CFuzzNode::all().begin();
    }
    return 0;
}
