#include "shell/update_check.h"

#include <gtest/gtest.h>

#include <QHostAddress>
#include <QPushButton>
#include <QSignalSpy>
#include <QTcpServer>
#include <QTcpSocket>
#include <map>
#include <memory>

#include "catalog/ini.h"
#include "fakes.h"
#include "support/temp_dir.h"

namespace kickvane::shell {
namespace {

using testing::RecordingDialogs;
using testing::TempDir;
using testing::WriteFile;

constexpr int kWaitMs = 10000;

const QByteArray kNoAnswer("");  // a response the server never sends

QByteArray Response(const QByteArray& status, const QByteArray& body,
                    const QByteArray& headers = {}) {
    return "HTTP/1.1 " + status + "\r\n" + headers +
           "Content-Length: " + QByteArray::number(body.size()) + "\r\n\r\n" + body;
}

QByteArray Ok(const QByteArray& body) {
    return Response("200 OK", body);
}

QByteArray NotFound() {
    return Response("404 Not Found", "not found");
}

QByteArray Redirect(const QByteArray& location) {
    return Response("302 Found", {}, "Location: " + location + "\r\n");
}

// An HTTP server on 127.0.0.1 that answers each path with a canned response: 404 for paths it
// does not know, and no answer at all for an empty response.
class CannedServer : public QObject {
public:
    CannedServer() {
        EXPECT_TRUE(server_.listen(QHostAddress::LocalHost, 0));
        connect(&server_, &QTcpServer::newConnection, this, [this] {
            while (QTcpSocket* socket = server_.nextPendingConnection()) {
                socket->setParent(this);
                connect(socket, &QTcpSocket::readyRead, this, [this, socket] { serve(socket); });
            }
        });
    }

    QUrl root() const {
        return QUrl(QStringLiteral("http://127.0.0.1:%1/").arg(server_.serverPort()));
    }
    QByteArray origin() const {
        return "http://127.0.0.1:" + QByteArray::number(server_.serverPort());
    }

    std::map<QByteArray, QByteArray> responses;
    QList<QByteArray> requests;  // request heads, in the order they came

private:
    // Answers each complete request on the connection; keeps it open unless the response says
    // "Connection: close".
    void serve(QTcpSocket* socket) {
        QByteArray& pending = pending_[socket];
        pending += socket->readAll();
        for (qsizetype end = pending.indexOf("\r\n\r\n"); end >= 0;
             end = pending.indexOf("\r\n\r\n")) {
            const QByteArray head = pending.left(end + 4);
            pending.remove(0, end + 4);
            requests << head;
            const auto found = responses.find(head.split(' ').value(1));
            const QByteArray response = found != responses.end() ? found->second : NotFound();
            if (response.isEmpty()) {
                continue;  // never answers
            }
            socket->write(response);
            if (response.contains("Connection: close")) {
                socket->disconnectFromHost();
                return;
            }
        }
    }

    QTcpServer server_;
    std::map<QTcpSocket*, QByteArray> pending_;
};

TEST(UpdateCheckTextTest, EveryLineEndsInCrLfAndOnlyCrEndsALine) {
    EXPECT_EQ(ReadFetchedText("v2.1"), "v2.1\r\n");
    EXPECT_EQ(ReadFetchedText("v2.1\r\n"), "v2.1\r\n");
    EXPECT_EQ(ReadFetchedText("a\rb"), "a\r\nb\r\n");
    EXPECT_EQ(ReadFetchedText("a\r\n\r\nb"), "a\r\n\r\nb\r\n");
    EXPECT_EQ(ReadFetchedText("v2.0-demo\n"), "v2.0-demo\n\r\n");
    EXPECT_EQ(ReadFetchedText("a\nb\r"), "a\nb\r\n");
    EXPECT_EQ(ReadFetchedText(""), "");
}

TEST(UpdateCheckTextTest, BytesThatAreNotUtf8AreReadAsWindows1252) {
    EXPECT_EQ(ReadFetchedText("phi\xEAn \x80"), "phiên €\r\n");
    EXPECT_EQ(ReadFetchedText("phiên"), "phiên\r\n");
}

TEST(UpdateCheckTextTest, OnlyTheExactVersionLineIsCurrent) {
    EXPECT_TRUE(IsCurrentVersion("v2.0-demo\r\n"));
    EXPECT_TRUE(IsCurrentVersion(ReadFetchedText("v2.0-demo")));
    EXPECT_FALSE(IsCurrentVersion(ReadFetchedText("v2.0-demo ")));
    EXPECT_FALSE(IsCurrentVersion(ReadFetchedText("v2.0-demo\r\nbeta")));
    EXPECT_FALSE(IsCurrentVersion(ReadFetchedText("v2.0-demo\n")));
    EXPECT_FALSE(IsCurrentVersion(ReadFetchedText("V2.0-DEMO")));
    EXPECT_FALSE(IsCurrentVersion(ReadFetchedText("")));
}

TEST(UpdateCheckTextTest, DownloadLinkIsAWebAddressWithoutSurroundingBlanks) {
    EXPECT_EQ(DownloadLink(" https://dl.example.net/kv.zip \r\n"), "https://dl.example.net/kv.zip");
    EXPECT_EQ(DownloadLink("HTTP://dl.example.net"), "HTTP://dl.example.net");
    EXPECT_EQ(DownloadLink("http://user@[::1]:8080/a"), "http://user@[::1]:8080/a");
    for (const char* refused :
         {"", "\r\n", "file:///etc/passwd", "javascript:alert(1)", "C:\\x.exe", "ftp://x.net/a",
          "http://", "https:///a", "http://:80/", "http://[]/", "http://a.net/\r\nhttp://b.net/",
          "http://a.net\\@b.net/", "data:text/html,x"}) {
        EXPECT_EQ(DownloadLink(refused), std::nullopt) << refused;
    }
}

TEST(UpdateCheckTextTest, RedirectsStayOnTheHostAndNeverLeaveHttps) {
    const QUrl origin(QStringLiteral("http://up.example.net/v"));
    const QUrl secure(QStringLiteral("https://up.example.net/v"));
    EXPECT_TRUE(UpdateCheck::AllowsRedirect(origin, origin, QUrl("http://up.example.net/v2")));
    EXPECT_TRUE(UpdateCheck::AllowsRedirect(origin, origin, secure));
    EXPECT_TRUE(UpdateCheck::AllowsRedirect(origin, secure, QUrl("https://up.example.net/x")));
    EXPECT_FALSE(UpdateCheck::AllowsRedirect(origin, secure, origin));
    EXPECT_FALSE(UpdateCheck::AllowsRedirect(origin, origin, QUrl("http://evil.example.net/v")));
    EXPECT_FALSE(UpdateCheck::AllowsRedirect(origin, origin, QUrl("http://up.example.net:81/v")));
    EXPECT_FALSE(UpdateCheck::AllowsRedirect(origin, origin, QUrl("file:///etc/passwd")));
}

class UpdateFlowTest : public ::testing::Test {
protected:
    UpdateFlowTest() { download_->hide(); }

    std::unique_ptr<UpdateFlow> Flow(std::chrono::milliseconds timeout = std::chrono::seconds(10)) {
        UpdateCheck::Options options;
        options.host = server_.root();
        options.timeout = timeout;
        return std::make_unique<UpdateFlow>(options, dir_.path(), dialogs_, &window_, check_,
                                            download_, &pban_, &vlk_, [this](const QUrl& url) {
                                                opened_ << url;
                                                return true;
                                            });
    }

    // Runs a check to its message, and the link fetch to its end when one started.
    void Check(UpdateFlow& flow) {
        QSignalSpy checked(&flow, &UpdateFlow::checkFinished);
        QSignalSpy linked(&flow, &UpdateFlow::linkFinished);
        flow.check();
        ASSERT_TRUE(checked.wait(kWaitMs));
        if (Shown(download_) && linked.isEmpty()) {
            ASSERT_TRUE(linked.wait(kWaitMs));
        }
    }

    static QString Message(const char* text) {
        return QStringLiteral("Thông báo|") + QString::fromUtf8(text);
    }
    bool Shown(const QWidget* button) const { return button->isVisibleTo(&window_); }
    bool SettingsWritten() const { return !std::filesystem::is_empty(dir_.path()); }

    TempDir dir_;
    CannedServer server_;
    RecordingDialogs dialogs_;
    QWidget window_;
    QPushButton* check_ = new QPushButton(&window_);
    QPushButton* download_ = new QPushButton(&window_);
    QString pban_;
    QString vlk_;
    QList<QUrl> opened_;
};

TEST_F(UpdateFlowTest, SameVersionSaysSoAndChangesNothing) {
    server_.responses["/v"] = Ok("v2.0-demo");
    server_.responses["/vlink"] = Ok("https://dl.example.net/kv.zip");
    auto flow = Flow();
    QSignalSpy checked(flow.get(), &UpdateFlow::checkFinished);
    flow->check();
    EXPECT_FALSE(check_->isEnabled());
    ASSERT_TRUE(checked.wait(kWaitMs));

    EXPECT_EQ(dialogs_.messages, QStringList{Message("Chưa có phiên bản mới")});
    EXPECT_EQ(pban_, "v2.0-demo\r\n");
    EXPECT_TRUE(check_->isEnabled());
    EXPECT_TRUE(Shown(check_));
    EXPECT_FALSE(Shown(download_));
    EXPECT_EQ(server_.requests.size(), 1);
    EXPECT_FALSE(SettingsWritten());
}

TEST_F(UpdateFlowTest, NewerVersionIsRecordedSwapsTheButtonsAndDownloadOpensTheLink) {
    // The settings file exists under another letter case; the version goes into that file.
    WriteFile(dir_ / "Thietlap.ini", "[Thiet lap]\r\nDuongDan=C:\\Game\r\n");
    server_.responses["/v"] = Ok("v2.1\r\n");
    server_.responses["/vlink"] = Ok("https://dl.example.net/kv-2.1.zip\r\n");
    auto flow = Flow();
    Check(*flow);

    EXPECT_EQ(dialogs_.messages, QStringList{Message("Đã có phiên bản mới! v2.1\r\n")});
    EXPECT_EQ(pban_, "v2.1\r\n");
    EXPECT_EQ(vlk_, "https://dl.example.net/kv-2.1.zip\r\n");
    EXPECT_FALSE(Shown(check_));
    EXPECT_TRUE(Shown(download_));
    const auto ini = dir_ / "Thietlap.ini";
    EXPECT_EQ(catalog::ReadIni(ini, "KiemTra", "PhienBan", "-"), "v2.1");
    EXPECT_EQ(catalog::ReadIni(ini, "Thiet lap", "DuongDan", "-"), "C:\\Game");
    EXPECT_EQ(std::distance(std::filesystem::directory_iterator(dir_.path()), {}), 1);
    for (const QByteArray& request : server_.requests) {
        EXPECT_TRUE(request.toLower().contains("cache-control: no-cache")) << request.data();
    }

    flow->download();
    EXPECT_EQ(opened_, QList<QUrl>{QUrl("https://dl.example.net/kv-2.1.zip")});
    EXPECT_EQ(dialogs_.messages.size(), 1);
}

TEST_F(UpdateFlowTest, AnyOtherVersionTextCountsAsNewerAndIsShownConverted) {
    const std::vector<std::pair<QByteArray, const char*>> cases = {
        {"", "Đã có phiên bản mới! "},
        {"v2.0-demo\n", "Đã có phiên bản mới! v2.0-demo\n\r\n"},
        {"v2.0-demo \r\n", "Đã có phiên bản mới! v2.0-demo \r\n"},
        {"v2.0-demo\r\nbeta", "Đã có phiên bản mới! v2.0-demo\r\nbeta\r\n"},
        {"v3 mo71i", "Đã có phiên bản mới! v3 mới\r\n"},
    };
    for (const auto& [body, message] : cases) {
        SCOPED_TRACE(body.toStdString());
        server_.responses["/v"] = Ok(body);
        dialogs_.messages.clear();
        check_->show();
        download_->hide();
        auto flow = Flow();
        Check(*flow);
        EXPECT_EQ(dialogs_.messages, QStringList{Message(message)});
        EXPECT_EQ(pban_, QString::fromUtf8(ReadFetchedText(body.toStdString())));
        EXPECT_FALSE(Shown(check_));
        EXPECT_TRUE(Shown(download_));
    }
}

TEST_F(UpdateFlowTest, FailedChecksAreReportedAndChangeNothing) {
    const QByteArray big(64 * 1024 + 1, 'v');
    struct Case {
        const char* name;
        QByteArray response;  // none: the file is missing
        const char* reason;
    };
    const std::vector<Case> cases = {
        {"missing file", {}, "HTTP 404"},
        {"server error", Response("500 Internal Server Error", "v9"), "HTTP 500"},
        {"declared too large", Ok(big), "quá lớn"},
        {"streamed too large", "HTTP/1.1 200 OK\r\nConnection: close\r\n\r\n" + big, "quá lớn"},
        {"redirect to another host", Redirect("http://localhost:1/v"), "không được phép"},
        {"too many redirects", Redirect("/r1"), "quá nhiều lần"},
        {"no answer", kNoAnswer, "không trả lời kịp"},
    };
    for (const auto& [name, response, reason] : cases) {
        SCOPED_TRACE(name);
        server_.responses.erase("/v");
        if (!response.isNull()) {
            server_.responses["/v"] = response;
        }
        server_.responses["/vlink"] = Ok("https://dl.example.net/kv.zip");
        server_.responses["/r1"] = Redirect("/r2");
        server_.responses["/r2"] = Redirect("/r3");
        server_.responses["/r3"] = Redirect("/r4");
        server_.responses["/r4"] = Ok("v2.1");
        dialogs_.messages.clear();
        pban_ = "v1.9\r\n";
        const int requestsBefore = static_cast<int>(server_.requests.size());
        // A short limit for the silent server only: any other case must fail for its own reason.
        const bool silent = !response.isNull() && response.isEmpty();
        auto flow = silent ? Flow(std::chrono::milliseconds(300)) : Flow();
        Check(*flow);

        ASSERT_EQ(dialogs_.messages.size(), 1);
        EXPECT_TRUE(dialogs_.messages[0].startsWith(Message("Không kiểm tra được phiên bản mới: ")))
            << dialogs_.messages[0].toStdString();
        EXPECT_TRUE(dialogs_.messages[0].contains(QString::fromUtf8(reason)))
            << dialogs_.messages[0].toStdString();
        EXPECT_EQ(pban_, "v1.9\r\n");
        EXPECT_TRUE(vlk_.isEmpty());
        EXPECT_TRUE(check_->isEnabled());
        EXPECT_TRUE(Shown(check_));
        EXPECT_FALSE(Shown(download_));
        EXPECT_FALSE(SettingsWritten());
        for (int i = requestsBefore; i < server_.requests.size(); ++i) {
            EXPECT_FALSE(server_.requests[i].startsWith("GET /vlink"));
        }
    }
}

TEST_F(UpdateFlowTest, RedirectsOnTheSameHostAreFollowedUpToTheLimit) {
    server_.responses["/v"] = Redirect(server_.origin() + "/current/v");
    server_.responses["/current/v"] = Redirect("again");
    server_.responses["/current/again"] = Redirect("/last");
    server_.responses["/last"] = Ok("v2.0-demo\r\n");
    auto flow = Flow();
    Check(*flow);
    EXPECT_EQ(dialogs_.messages, QStringList{Message("Chưa có phiên bản mới")});
}

TEST_F(UpdateFlowTest, DownloadOpensNothingButAWebAddress) {
    auto flow = Flow();
    flow->download();  // before any check: no link yet
    EXPECT_EQ(dialogs_.messages.size(), 1);

    server_.responses["/v"] = Ok("v2.1");
    for (const QByteArray& link :
         {QByteArray("file:///etc/passwd\r\n"), QByteArray("javascript:alert(1)"), QByteArray()}) {
        SCOPED_TRACE(link.toStdString());
        server_.responses["/vlink"] = Ok(link);
        check_->show();
        auto checked = Flow();
        Check(*checked);
        dialogs_.messages.clear();
        checked->download();
        EXPECT_EQ(dialogs_.messages.size(), 1);
    }

    server_.responses.erase("/vlink");  // the link fetch fails
    vlk_.clear();
    check_->show();
    flow = Flow();
    QSignalSpy linked(flow.get(), &UpdateFlow::linkFinished);
    flow->check();
    ASSERT_TRUE(linked.wait(kWaitMs));
    dialogs_.messages.clear();
    flow->download();
    EXPECT_EQ(dialogs_.messages.size(), 1);
    EXPECT_TRUE(vlk_.isEmpty());
    EXPECT_TRUE(opened_.isEmpty());
}

}  // namespace
}  // namespace kickvane::shell
