// The update check's failures reach the user in Vietnamese, never in Qt's English.
#include "shell/fetch_problem.h"

#include <gtest/gtest.h>

#include <QHostAddress>
#include <QSignalSpy>
#include <QTcpServer>
#include <set>

#include "shell/update_check.h"

namespace kickvane::shell {
namespace {

// The words of each reason are checked where the user reads them, in the update flow's
// messages; here, what the table does not name, and that no two problems read alike.
TEST(FetchProblemTest, UnnamedQtErrorsGiveTheirCode_AndEveryProblemHasItsOwnWords) {
    EXPECT_EQ(networkErrorText(QNetworkReply::ContentAccessDenied), "lỗi mạng (mã 201)");
    // Every problem has its own words, so the user can tell them apart.
    std::set<QString> texts;
    for (int p = 0; p <= static_cast<int>(FetchProblem::Other); ++p) {
        texts.insert(fetchProblemText(static_cast<FetchProblem>(p), 7));
    }
    EXPECT_EQ(texts.size(), static_cast<size_t>(FetchProblem::Other) + 1);
}

TEST(FetchProblemTest, RealRefusedAndClosedConnectionsAreSaidInVietnamese) {
    QTcpServer server;
    ASSERT_TRUE(server.listen(QHostAddress::LocalHost));
    // A server that hangs up on every request without an answer.
    QObject::connect(&server, &QTcpServer::newConnection, &server, [&server] {
        while (QTcpSocket* socket = server.nextPendingConnection()) {
            QObject::connect(socket, &QTcpSocket::readyRead, socket,
                             [socket] { socket->disconnectFromHost(); });
        }
    });
    const QString closing = QStringLiteral("http://127.0.0.1:%1/").arg(server.serverPort());
    QTcpServer gone;
    ASSERT_TRUE(gone.listen(QHostAddress::LocalHost));
    const QString refusing = QStringLiteral("http://127.0.0.1:%1/").arg(gone.serverPort());
    gone.close();

    for (const auto& [host, problem] : {std::pair{closing, FetchProblem::ConnectionClosed},
                                        std::pair{refusing, FetchProblem::ConnectionRefused}}) {
        UpdateCheck check(UpdateCheck::Options{QUrl(host), std::chrono::seconds(10)});
        QSignalSpy failed(&check, &UpdateCheck::versionFailed);
        check.fetchVersion();
        ASSERT_TRUE(failed.wait(10000)) << host.toStdString();
        EXPECT_EQ(failed.at(0).at(0).toString(), fetchProblemText(problem));
    }
}

}  // namespace
}  // namespace kickvane::shell
