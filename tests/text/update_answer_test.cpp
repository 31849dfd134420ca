#include "text/update_answer.h"

#include <gtest/gtest.h>

#include <string>

namespace kickvane::text {
namespace {

TEST(UpdateAnswerTest, AVersionIsOneShortLineOfPrintableCharacters) {
    for (const std::string& version :
         {std::string("v2.0-demo"), std::string("v2.1 "), std::string("v2.1-thử"),
          std::string("2\n"), std::string(kMaxVersionLength, 'v')}) {
        EXPECT_TRUE(IsVersionText(ReadFetchedText(version))) << version;
        EXPECT_TRUE(IsVersionText(ReadFetchedText(version + "\r\n"))) << version;
    }
    for (const std::string& junk :
         {std::string(), std::string("\n"), std::string("   "), std::string("v2.1\r\nv2.2"),
          std::string("v2.0\n\n"), std::string("<html>\n<body>login</body>\n</html>"),
          std::string("\x89PNG\r\n\x1A\n", 8), std::string("v\0 2", 4), std::string("a\tb"),
          std::string(kMaxVersionLength + 1, 'v')}) {
        EXPECT_FALSE(IsVersionText(ReadFetchedText(junk))) << ::testing::PrintToString(junk);
    }
}

}  // namespace
}  // namespace kickvane::text
