#include "platform/base/Object.h"

#include "platform/base/Exception.h"

#include <gtest/gtest.h>

#include <cstdlib>
#include <memory>

namespace {

class CShape : public CObject {
    DECLARE_DYNAMIC(CShape)
};
IMPLEMENT_DYNAMIC(CShape, CObject)

/// A class without information of its own between two that have it.
class CPlainShape : public CShape {};

class CCircle : public CPlainShape {
    DECLARE_DYNCREATE(CCircle)

public:
    void AssertValid() const override {
        CPlainShape::AssertValid();
        ASSERT(m_radius >= 0);
    }
    void Dump(CDumpContext& context) const override {
        CPlainShape::Dump(context);
        context << "radius " << m_radius << ", next " << static_cast<const CObject*>(nullptr) << "\n";
    }

    int m_radius = 0;
};
IMPLEMENT_DYNCREATE(CCircle, CPlainShape)

} // namespace

TEST(RuntimeClass, KnowsNameSizeAndBases) {
    CCircle circle;
    EXPECT_STREQ("CCircle", circle.GetRuntimeClass()->m_lpszClassName);
    EXPECT_EQ(static_cast<int>(sizeof(CCircle)), RUNTIME_CLASS(CCircle)->m_nObjectSize);
    EXPECT_TRUE(circle.IsKindOf(RUNTIME_CLASS(CShape)));
    EXPECT_TRUE(circle.IsKindOf(RUNTIME_CLASS(CObject)));
    EXPECT_FALSE(RUNTIME_CLASS(CShape)->IsDerivedFrom(RUNTIME_CLASS(CCircle)));
    EXPECT_FALSE(circle.IsSerializable());
}

TEST(RuntimeClass, MakesObjectsByNameWhereTheClassAllows) {
    EXPECT_EQ(RUNTIME_CLASS(CShape), CRuntimeClass::FromName("CShape"));
    const std::unique_ptr<CObject> object(CRuntimeClass::CreateObject("CCircle"));
    EXPECT_NE(nullptr, DYNAMIC_DOWNCAST(CCircle, object.get()));
    EXPECT_EQ(nullptr, RUNTIME_CLASS(CShape)->CreateObject());
    EXPECT_EQ(nullptr, CRuntimeClass::CreateObject("CCirc"));
    EXPECT_EQ(nullptr, CRuntimeClass::FromName(nullptr));
    EXPECT_EQ(nullptr, DYNAMIC_DOWNCAST(CException, object.get()));
    EXPECT_EQ(nullptr, DYNAMIC_DOWNCAST(CException, nullptr));
}

TEST(RuntimeClass, LeavesTheListWithItsLibrary) {
    static CRuntimeClass loaded = {"CLoadedLater", 1, 0xFFFF, nullptr, &CObject::GetThisClass, nullptr};
    {
        const AFX_CLASSINIT registration(&loaded);
        EXPECT_EQ(&loaded, CRuntimeClass::FromName("CLoadedLater"));
    }
    EXPECT_EQ(nullptr, CRuntimeClass::FromName("CLoadedLater"));
    EXPECT_NE(nullptr, CRuntimeClass::FromName("CCircle"));
}

TEST(Diagnostics, TraceAndDumpSpeakOnlyWhenAsked) {
    const CCircle circle;
    const auto said = [&] {
        testing::internal::CaptureStderr();
        TRACE("traced %d\n", 7);
        TRACE("traced %s\n", CString("text"));
        afxDump << circle;
        return testing::internal::GetCapturedStderr();
    };
    ::unsetenv("TVX_TRACE");
    EXPECT_EQ("", said());
    ::setenv("TVX_TRACE", "1", 1);
    const std::string text = said();
    ::unsetenv("TVX_TRACE");
    EXPECT_TRUE(text.starts_with("traced 7\ntraced text\na CCircle at ")) << text;
    EXPECT_TRUE(text.ends_with("radius 0, next NULL\n")) << text;
}

TEST(Diagnostics, DumpOverridesReadHowDeepToGo) {
    CDumpContext dump;
    EXPECT_EQ(0, dump.GetDepth());
    dump.SetDepth(2);
    EXPECT_EQ(2, dump.GetDepth());
    EXPECT_EQ(0, afxDump.GetDepth()) << "each context has its own";
}

TEST(DiagnosticsDeathTest, BrokenInvariantsEndTheProcess) {
    CCircle circle;
    ASSERT_VALID(&circle);
    circle.m_radius = -1;
    EXPECT_DEATH(ASSERT_VALID(&circle), "assertion failed: m_radius >= 0");
    EXPECT_DEATH(ASSERT_VALID(static_cast<CObject*>(nullptr)), "not null");
}
