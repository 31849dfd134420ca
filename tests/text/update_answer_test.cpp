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

TEST(UpdateAnswerTest, AnAnswerNamesAVersionOnlyWhenItIsOneVersionNumber) {
    for (const char* version : {"v2.0-demo", "v2.1", "2.1.3", "v2.0-beta1", "7", "v10.0.RC-2"}) {
        EXPECT_EQ(VersionFromAnswer(ReadFetchedText(version)), version) << version;
    }
    // Blanks and line ends around it do not count, whatever the server's line ends.
    for (const char* padded : {"v2.1\n", " v2.1\r\n\r\n", "\tv2.1 \n", "v2.1\r"}) {
        EXPECT_EQ(VersionFromAnswer(ReadFetchedText(padded)), "v2.1") << padded;
    }
    const std::string longest = "v" + std::string(kMaxVersionLength - 1, '1');
    EXPECT_EQ(VersionFromAnswer(longest), longest);
    for (const std::string& junk :
         {std::string(), std::string("\n"), std::string("   "), std::string("v"),
          std::string("v.2"), std::string("V2.1"), std::string("beta"), std::string("hello world"),
          std::string("v2.1\r\nv2.2"), std::string("<html><body>v9.9</body></html>"),
          std::string("<img src=\"file:///etc/x.png\">"), std::string("<h1>404</h1>"),
          std::string("2.1&amp;"), std::string("v2.1 beta"), std::string("v2.1-thử"),
          std::string("v\0 2", 4), std::string("\x89PNG\r\n\x1A\n", 8), longest + "1"}) {
        EXPECT_EQ(VersionFromAnswer(ReadFetchedText(junk)), std::nullopt)
            << ::testing::PrintToString(junk);
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
