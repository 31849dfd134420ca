#include "platform/program.h"

#include <gtest/gtest.h>

namespace kickvane::platform {
namespace {

// Text written to a console in pieces: a letter cut between two pieces waits for its end, and
// bytes that cannot begin a letter never hold the rest back.
TEST(CompleteUtf8Length, HoldsBackOnlyALetterCutAtTheEnd) {
    const std::string viet = "Vi\xE1\xBB\x87t";  // "Việt": ệ takes three bytes
    EXPECT_EQ(CompleteUtf8Length(viet), viet.size());
    EXPECT_EQ(CompleteUtf8Length(viet.substr(0, 3)), 2u);
    EXPECT_EQ(CompleteUtf8Length(viet.substr(0, 4)), 2u);
    EXPECT_EQ(CompleteUtf8Length(viet.substr(0, 5)), 5u);
    EXPECT_EQ(CompleteUtf8Length("\xF0\x9F\x98"), 0u);        // an emoji short of one byte
    EXPECT_EQ(CompleteUtf8Length("ab\xC3"), 2u);              // "ô" short of one byte
    EXPECT_EQ(CompleteUtf8Length("ab\x80\x80\x80\x80"), 6u);  // stray continuation bytes
    EXPECT_EQ(CompleteUtf8Length("ab\xFF"), 3u);              // no letter begins so
    EXPECT_EQ(CompleteUtf8Length(""), 0u);
}

}  // namespace
}  // namespace kickvane::platform
