#include "platform/base/Exception.h"

#include <gtest/gtest.h>

#include <cerrno>

namespace {

int liveExceptions = 0;

/// An exception of a host's own that counts its lives.
class CCountedException : public CException {
    DECLARE_DYNAMIC(CCountedException)

public:
    CCountedException() {
        ++liveExceptions;
    }
    ~CCountedException() override {
        --liveExceptions;
    }
};
IMPLEMENT_DYNAMIC(CCountedException, CException)

CString messageOf(const CException& exception) {
    CString text;
    exception.GetErrorMessage(text.GetBuffer(200), 200);
    text.ReleaseBuffer();
    return text;
}

} // namespace

TEST(Exception, CatchBlocksDeleteWhatTheyCaught) {
    int caught = 0;
    TRY {
        THROW(new CCountedException);
    }
    CATCH(CFileException, e) {
        ADD_FAILURE() << "wrong class";
    }
    AND_CATCH(CCountedException, e) {
        EXPECT_EQ(1, liveExceptions);
        ++caught;
    }
    END_CATCH
    EXPECT_EQ(1, caught);
    EXPECT_EQ(0, liveExceptions);
}

TEST(Exception, IsPassedOnAlive) {
    try {
        TRY {
            THROW(new CCountedException);
        }
        CATCH_ALL(e) {
            THROW_LAST();
        }
        END_CATCH_ALL
        ADD_FAILURE() << "the exception was not passed on";
    } catch (CException* e) {
        EXPECT_EQ(1, liveExceptions);
        EXPECT_TRUE(e->IsKindOf(RUNTIME_CLASS(CCountedException)));
        e->Delete();
    }
    EXPECT_EQ(0, liveExceptions);
}

TEST(Exception, SharedOnesOutliveDelete) {
    CException* first = nullptr;
    for (int i = 0; i < 2; ++i) {
        try {
            AfxThrowMemoryException();
        } catch (CMemoryException* e) {
            EXPECT_TRUE(!first || first == e);
            first = e;
            e->Delete();
        }
    }
    EXPECT_EQ("Out of memory.", messageOf(*first));
}

TEST(Exception, StandardAllocationFailuresBecomeTheFrameworks) {
    EXPECT_THROW(tvx::allocating([] { throw std::bad_alloc(); }), CMemoryException*);
    EXPECT_THROW(tvx::allocating([] { std::string().reserve(SIZE_MAX); }), CMemoryException*);
}

TEST(Exception, DescribesFileErrorsWithTheFile) {
    try {
        CFileException::ThrowErrno(ENOENT, "C:\\a.brd");
    } catch (CFileException* e) {
        EXPECT_EQ(CFileException::fileNotFound, e->m_cause);
        EXPECT_EQ(ENOENT, e->m_lOsError);
        EXPECT_EQ("/a.brd was not found.", messageOf(*e)) << "as the user knows the file";
        e->Delete();
    }
    EXPECT_EQ(CFileException::genericException, CFileException::ErrnoToException(ENOSYS));
}

TEST(Exception, CutsMessagesBetweenCharacters) {
    const CFileException error(CFileException::fileNotFound, -1, "äää");
    char text[6];
    EXPECT_TRUE(error.GetErrorMessage(text, sizeof text));
    EXPECT_STREQ("ää", text);
    EXPECT_TRUE(error.GetErrorMessage(nullptr, 0));
    EXPECT_FALSE(CUserException().GetErrorMessage(text, sizeof text));
    EXPECT_STREQ("", text);
}

TEST(Exception, IsReportedOnStandardErrorWithoutMessageBoxes) {
    tvx::setExceptionReporter(nullptr);
    testing::internal::CaptureStderr();
    CFileException(CFileException::diskFull, ENOSPC, "a.brd").ReportError();
    EXPECT_EQ("The disk is full while accessing a.brd.\n", testing::internal::GetCapturedStderr());

    static CString reported;
    tvx::setExceptionReporter([](const CString& text, UINT type, UINT) {
        reported = text;
        return static_cast<int>(type) + 1;
    });
    EXPECT_EQ(49, CArchiveException(CArchiveException::badSchema, "a.brd").ReportError(48));
    tvx::setExceptionReporter(nullptr);
    EXPECT_EQ("a.brd was written by another version of the program.", reported);
}
