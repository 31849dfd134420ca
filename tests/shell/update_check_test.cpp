#include "shell/update_check.h"
#include "shell/update_flow.h"

#include <gtest/gtest.h>

#include <QHostAddress>
#include <QPushButton>
#include <QSignalSpy>
#include <QTcpServer>
#include <QTcpSocket>
#include <map>
#include <memory>
#include <tuple>
#include <utility>
#include <vector>

#include "catalog/ini.h"
#include "fakes.h"
#include "support/temp_dir.h"

namespace kickvane::shell {
namespace {

using testing::RecordingDialogs;
using testing::TempDir;
using testing::WriteFile;

constexpr int kWaitMs = 10000;

QByteArray Response(const QByteArray& status, const QByteArray& body,
                    const QByteArray& headers = {}) {
    return "HTTP/1.1 " + status + "\r\n" + headers +
           "Content-Length: " + QByteArray::number(body.size()) + "\r\n\r\n" + body;
}
QByteArray Ok(const QByteArray& body) {
    return Response("200 OK", body);
}
QByteArray Redirect(const QByteArray& to) {
    return Response("302 Found", {}, "Location: " + to + "\r\n");
}

// Blanks and line ends around an answer are the answer reader's own test; the fetched version
// in the message is the flow's.
TEST(UpdateCheckTextTest, OnlyOurOwnVersionIsCurrent_AndFailureMessagesKeepNoLastWordAlone) {
    EXPECT_TRUE(isCurrentVersion(ReadFetchedText("v2.0-demo\r\n\r\n")));
    for (const char* other : {"v2.0-demo\r\nbeta", "V2.0-DEMO", "v2.0-demo2", "v2.0", ""}) {
        EXPECT_FALSE(isCurrentVersion(ReadFetchedText(other))) << other;
    }
    EXPECT_EQ(checkFailedText(QStringLiteral("máy chủ không trả lời kịp ")),
              QStringLiteral("Không kiểm tra được phiên bản mới:\nmáy chủ không trả lời\u00A0kịp"));
}

TEST(UpdateCheckTextTest, RedirectsStayOnTheHostAndNeverLeaveHttps) {
    const QUrl origin(QStringLiteral("http://up.example.net/v"));
    const QUrl secure(QStringLiteral("https://up.example.net/v"));
    EXPECT_TRUE(UpdateCheck::allowsRedirect(origin, origin, QUrl("http://up.example.net/v2")));
    EXPECT_TRUE(UpdateCheck::allowsRedirect(origin, origin, secure));
    EXPECT_TRUE(UpdateCheck::allowsRedirect(origin, secure, QUrl("https://up.example.net/x")));
    EXPECT_FALSE(UpdateCheck::allowsRedirect(origin, secure, origin));
    EXPECT_FALSE(UpdateCheck::allowsRedirect(origin, origin, QUrl("http://evil.example.net/v")));
    EXPECT_FALSE(UpdateCheck::allowsRedirect(origin, origin, QUrl("http://up.example.net:81/v")));
    EXPECT_FALSE(UpdateCheck::allowsRedirect(origin, origin, QUrl("file:///etc/passwd")));
}

// A window with the update buttons, and an HTTP server on 127.0.0.1 that answers each path with
// its canned response: 404 for a path it does not know or whose response is null, and no answer
// at all for an empty response.
class UpdateFlowTest : public ::testing::Test {
protected:
    UpdateFlowTest() {
        EXPECT_TRUE(server_.listen(QHostAddress::LocalHost, 0));
        QObject::connect(&server_, &QTcpServer::newConnection, &server_, [this] {
            while (QTcpSocket* socket = server_.nextPendingConnection()) {
                QObject::connect(socket, &QTcpSocket::readyRead, socket,
                                 [this, socket] { Serve(socket); });
            }
        });
    }

    // Answers a request once its head is in; closes the connection after "Connection: close".
    void Serve(QTcpSocket* socket) {
        QByteArray& head = heads_[socket];
        head += socket->readAll();
        if (!head.endsWith("\r\n\r\n")) {
            return;
        }
        requests_ << std::exchange(head, {});
        const auto found = responses_.find(requests_.back().split(' ').value(1));
        const QByteArray response = found != responses_.end() && !found->second.isNull()
                                        ? found->second
                                        : Response("404 Not Found", "no");
        socket->write(response);
        if (response.contains("Connection: close")) {
            socket->disconnectFromHost();
        }
    }

    QByteArray Root() const {
        return "http://127.0.0.1:" + QByteArray::number(server_.serverPort());
    }

    // A flow on a window as the tool starts: check button shown, download hidden, no messages.
    std::unique_ptr<UpdateFlow> Flow(std::chrono::milliseconds timeout = std::chrono::seconds(10)) {
        check_->show();
        download_->hide();
        dialogs_.messages.clear();
        return std::make_unique<UpdateFlow>(UpdateCheck::Options{QUrl(Root()), timeout}, *session_,
                                            dialogs_, &window_, check_, download_,
                                            [this](const QUrl& url) {
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

    QTcpServer server_;
    std::map<QTcpSocket*, QByteArray> heads_;
    std::map<QByteArray, QByteArray> responses_;
    QList<QByteArray> requests_;  // request heads, in the order they came
    TempDir dir_;
    RecordingDialogs dialogs_;
    QWidget window_;
    QPushButton* check_ = new QPushButton(&window_);
    QPushButton* download_ = new QPushButton(&window_);
    std::unique_ptr<session::Session> session_ = std::make_unique<session::Session>(dir_.path());
    QList<QUrl> opened_;
};

TEST_F(UpdateFlowTest, SameVersionSaysSoAndChangesNothing) {
    responses_["/v"] = Ok("v2.0-demo");
    responses_["/vlink"] = Ok("https://dl.example.net/kv.zip");
    auto flow = Flow();
    QSignalSpy checked(flow.get(), &UpdateFlow::checkFinished);
    flow->check();
    EXPECT_FALSE(check_->isEnabled());
    ASSERT_TRUE(checked.wait(kWaitMs));

    EXPECT_EQ(dialogs_.messages, QStringList{Message("Chưa có phiên bản mới")});
    EXPECT_EQ(session_->Updates().versionText, "v2.0-demo");
    EXPECT_TRUE(check_->isEnabled() && Shown(check_) && !Shown(download_));
    EXPECT_EQ(requests_.size(), 1);  // no link fetch
    EXPECT_FALSE(SettingsWritten());
}

// Redirects on the same host are followed up to the limit: absolute, relative and from the root.
TEST_F(UpdateFlowTest, NewerVersionIsShownConvertedRecordedAndSwapsTheButtons) {
    // The settings file exists under another letter case; the version goes into that file.
    WriteFile(dir_ / "Thietlap.ini", "[Thiet lap]\r\nDuongDan=C:\\Game\r\n");
    responses_["/v"] = Redirect(Root() + "/current/v");
    responses_["/current/v"] = Redirect("again");
    responses_["/current/again"] = Redirect("/last");
    responses_["/last"] = Ok("v2.1-beta1\r\n");
    responses_["/vlink"] = Ok("https://dl.example.net/kv-2.1.zip\r\n");
    auto flow = Flow();
    Check(*flow);

    EXPECT_EQ(dialogs_.messages, QStringList{Message("Đã có phiên bản mới! v2.1-beta1")});
    EXPECT_EQ(session_->Updates().versionText, "v2.1-beta1");
    EXPECT_EQ(session_->Updates().downloadLink, "https://dl.example.net/kv-2.1.zip\r\n");
    EXPECT_TRUE(!Shown(check_) && Shown(download_));
    const auto ini = dir_ / "Thietlap.ini";
    EXPECT_EQ(catalog::ReadIni(ini, "KiemTra", "PhienBan", "-"), "v2.1-beta1");
    EXPECT_EQ(catalog::ReadIni(ini, "Thiet lap", "DuongDan", "-"), "C:\\Game");
    EXPECT_EQ(std::distance(std::filesystem::directory_iterator(dir_.path()), {}), 1);
    for (const QByteArray& request : requests_) {
        EXPECT_TRUE(request.toLower().contains("cache-control: no-cache")) << request.data();
    }

    flow->download();
    EXPECT_EQ(opened_, QList<QUrl>{QUrl("https://dl.example.net/kv-2.1.zip")});
    EXPECT_EQ(dialogs_.messages.size(), 1);
}

TEST_F(UpdateFlowTest, FailedChecksAreReportedAndChangeNothing) {
    const QByteArray big(64 * 1024 + 1, 'v');
    responses_["/vlink"] = Ok("https://dl.example.net/kv.zip");
    for (int i = 1; i <= 3; ++i) {
        responses_["/r" + QByteArray::number(i)] = Redirect("/r" + QByteArray::number(i + 1));
    }
    responses_["/r4"] = Ok("v2.1");
    // A null response: the file is missing; an empty one: the server never answers.
    for (const auto& [name, response, reason] :
         std::vector<std::tuple<const char*, QByteArray, const char*>>{
             {"missing file", {}, "HTTP 404"},
             {"streamed too large", "HTTP/1.1 200 OK\r\nConnection: close\r\n\r\n" + big,
              "quá lớn"},
             {"redirect to another host", Redirect("http://localhost:1/v"), "không được phép"},
             {"too many redirects", Redirect("/r1"), "quá nhiều lần"},
             {"no answer", QByteArray(""), "không trả lời kịp"}}) {
        SCOPED_TRACE(name);
        responses_["/v"] = response;
        session_->KeepVersion("v1.9\r\n");
        const qsizetype requestsBefore = requests_.size();
        // A short limit for the silent server only: any other case must fail for its own reason.
        const bool silent = !response.isNull() && response.isEmpty();
        auto flow = silent ? Flow(std::chrono::milliseconds(300)) : Flow();
        Check(*flow);

        ASSERT_EQ(dialogs_.messages.size(), 1);
        const QString shown = QString(dialogs_.messages[0]).replace(QChar::Nbsp, u' ');
        EXPECT_TRUE(shown.startsWith(Message("Không kiểm tra được phiên bản mới:\n")) &&
                    shown.contains(QString::fromUtf8(reason)))
            << shown.toStdString();
        EXPECT_EQ(session_->Updates().versionText, "v1.9\r\n");
        EXPECT_TRUE(session_->Updates().downloadLink.empty());
        EXPECT_TRUE(check_->isEnabled() && Shown(check_) && !Shown(download_));
        EXPECT_FALSE(SettingsWritten());
        for (qsizetype i = requestsBefore; i < requests_.size(); ++i) {
            EXPECT_FALSE(requests_[i].startsWith("GET /vlink"));
        }
    }
}

TEST_F(UpdateFlowTest, AnAnswerThatIsNoVersionIsSaidSoAndChangesNothing) {
    responses_["/vlink"] = Ok("https://dl.example.net/kv.zip");
    // Which answers are no version is the answer reader's own test.
    for (const QByteArray& answer :
         {QByteArray("<html>\n<body>Wi-Fi login v9.9</body>\n</html>\n"), QByteArray("")}) {
        SCOPED_TRACE(answer.toStdString());
        responses_["/v"] = Ok(answer);
        session_->KeepVersion("v1.9");
        auto flow = Flow();
        Check(*flow);
        EXPECT_EQ(dialogs_.messages,
                  QStringList{Message("Máy chủ cập nhật trả lời không phải số phiên bản")});
        EXPECT_EQ(session_->Updates().versionText, "v1.9");
        EXPECT_TRUE(check_->isEnabled() && Shown(check_) && !Shown(download_));
        EXPECT_FALSE(SettingsWritten());
    }
    for (const QByteArray& request : requests_) {
        EXPECT_FALSE(request.startsWith("GET /vlink"));
    }
}

TEST_F(UpdateFlowTest, DownloadOpensNothingButAWebAddress) {
    auto flow = Flow();
    flow->download();  // before any check: no link yet
    EXPECT_EQ(dialogs_.messages.size(), 1);

    responses_["/v"] = Ok("v2.1");
    for (const QByteArray& response : {Ok("file:///etc/passwd\r\n"), QByteArray() /* none */}) {
        SCOPED_TRACE(response.toStdString());
        responses_["/vlink"] = response;
        session_->RecordDownloadLink({});
        flow = Flow();
        Check(*flow);
        dialogs_.messages.clear();
        flow->download();
        EXPECT_EQ(dialogs_.messages.size(), 1);
        if (response.isNull()) {
            EXPECT_TRUE(session_->Updates().downloadLink.empty());
        }
    }
    EXPECT_TRUE(opened_.isEmpty());
}

}  // namespace
}  // namespace kickvane::shell
