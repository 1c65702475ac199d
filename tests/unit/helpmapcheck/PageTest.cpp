#include "tools/helpmapcheck/Page.h"

#include <gtest/gtest.h>
#include <set>
#include <string>

namespace {

TEST(Page, HasTheAnchorsOfItsElements) {
    const struct {
        const char* page;
        std::set<std::string> anchors;
    } cases[] = {
        {"", {}},
        {"plain < text > id=\"no\" name='no'", {}},
        {"<h1 id=\"one\">1</h1><a name='two'>2</a><p ID = three class=x>", {"one", "two", "three"}},
        {"<h1\n\tclass=\"id='no'\"\r\nid=\"a b>c\"/>", {"a b>c"}},
        {"<!-- <p id=no> --><p id=yes><!-- <p id=no>", {"yes"}},
        {"<p hidden id=yes><p data-id=no xid=no idx=no></p id=yes2>", {"yes"}},
        {"<br/><p/id=yes><p = id=too>", {"yes", "too"}},
        {"<p id=\"not ended", {"not ended"}},
        {"<p id", {""}},
        {"<p id=>", {""}},
        {"<\xC3\xA4 id=no><p id=\xC3\xA4>", {"\xC3\xA4"}},
    };
    for (const auto& each : cases) {
        const auto anchors = helpmap::anchorsOf(each.page);
        EXPECT_EQ(std::set<std::string>(anchors.begin(), anchors.end()), each.anchors) << each.page;
    }
}

} // namespace
