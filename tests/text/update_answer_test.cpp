#include "text/update_answer.h"

#include <gtest/gtest.h>

#include <string>

namespace kickvane::text {
namespace {

TEST(UpdateAnswerTest, FetchedTextEndsLinesWithCrLfAndReadsBytesThatAreNotUtf8AsWindows1252) {
    EXPECT_EQ(ReadFetchedText("v2.1"), "v2.1\r\n");
    EXPECT_EQ(ReadFetchedText("a\rb"), "a\r\nb\r\n");
    EXPECT_EQ(ReadFetchedText("a\r\n\r\nb"), "a\r\n\r\nb\r\n");
    EXPECT_EQ(ReadFetchedText("v2.0\n"), "v2.0\n\r\n");  // a lone line feed stays
    EXPECT_EQ(ReadFetchedText(""), "");
    EXPECT_EQ(ReadFetchedText("phi\xEAn \x80"), "phiên €\r\n");
    EXPECT_EQ(ReadFetchedText("phiên"), "phiên\r\n");
}

TEST(UpdateAnswerTest, AVersionIsOneShortLineOfPrintableCharacters) {
    for (const std::string& version : {std::string("v2.0-demo"), std::string("v2.1-thử"),
                                       std::string("2\n"), std::string(kMaxVersionLength, 'v')}) {
        EXPECT_TRUE(IsVersionText(ReadFetchedText(version))) << version;
        EXPECT_TRUE(IsVersionText(ReadFetchedText(version + "\r\n"))) << version;
    }
    for (const std::string& junk :
         {std::string(), std::string("\n"), std::string("   "), std::string("v2.1\r\nv2.2"),
          std::string("<html>\n<body>login</body>\n</html>"), std::string("\x89PNG\r\n\x1A\n", 8),
          std::string("v\0 2", 4), std::string("a\tb"), std::string(kMaxVersionLength + 1, 'v')}) {
        EXPECT_FALSE(IsVersionText(ReadFetchedText(junk))) << ::testing::PrintToString(junk);
    }
}

TEST(UpdateAnswerTest, ADownloadLinkIsOneWebAddressWithoutSurroundingBlanks) {
    EXPECT_EQ(DownloadLink(" https://dl.example.net/kv.zip \r\n"), "https://dl.example.net/kv.zip");
    EXPECT_EQ(DownloadLink("HTTP://user@[::1]:8080/a"), "HTTP://user@[::1]:8080/a");
    for (const char* refused :
         {"", "file:///etc/passwd", "javascript:alert(1)", "C:\\x.exe", "ftp://x.net/a", "http://",
          "http://[]/", "http://a.net/\r\nhttp://b.net/", "http://a.net\\@b.net/"}) {
        EXPECT_EQ(DownloadLink(refused), std::nullopt) << refused;
    }
}

}  // namespace
}  // namespace kickvane::text
