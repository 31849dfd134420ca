#include "shell/fetch_problem.h"

namespace kickvane::shell {

FetchProblem problemOf(QNetworkReply::NetworkError error) {
    using E = QNetworkReply::NetworkError;
    switch (error) {
        case E::TimeoutError:
        case E::ProxyTimeoutError:
            return FetchProblem::TimedOut;
        case E::HostNotFoundError:
            return FetchProblem::HostNotFound;
        case E::ConnectionRefusedError:
            return FetchProblem::ConnectionRefused;
        case E::RemoteHostClosedError:
            return FetchProblem::ConnectionClosed;
        case E::SslHandshakeFailedError:
            return FetchProblem::SecureConnection;
        case E::TemporaryNetworkFailureError:
        case E::NetworkSessionFailedError:
        case E::BackgroundRequestNotAllowedError:
            return FetchProblem::NoNetwork;
        case E::ProxyConnectionRefusedError:
        case E::ProxyConnectionClosedError:
        case E::ProxyNotFoundError:
        case E::ProxyAuthenticationRequiredError:
            return FetchProblem::Proxy;
        case E::TooManyRedirectsError:
            return FetchProblem::TooManyRedirects;
        case E::InsecureRedirectError:
            return FetchProblem::RedirectRefused;
        case E::ProtocolUnknownError:
        case E::ProtocolInvalidOperationError:
        case E::ProtocolFailure:
            return FetchProblem::NotHttp;
        default:
            return FetchProblem::Other;
    }
}

QString fetchProblemText(FetchProblem problem, int detail) {
    switch (problem) {
        case FetchProblem::TimedOut:
            return QStringLiteral("máy chủ không trả lời kịp");
        case FetchProblem::HostNotFound:
            return QStringLiteral("không tìm thấy máy chủ cập nhật, hãy kiểm tra kết nối mạng");
        case FetchProblem::ConnectionRefused:
            return QStringLiteral("máy chủ cập nhật từ chối kết nối");
        case FetchProblem::ConnectionClosed:
            return QStringLiteral("máy chủ cập nhật đóng kết nối giữa chừng");
        case FetchProblem::SecureConnection:
            return QStringLiteral("không lập được kết nối bảo mật (TLS/SSL) với máy chủ");
        case FetchProblem::NoNetwork:
            return QStringLiteral("mạng đang gián đoạn, hãy kiểm tra kết nối mạng");
        case FetchProblem::Proxy:
            return QStringLiteral("không kết nối được qua máy chủ proxy");
        case FetchProblem::HttpStatus:
            return QStringLiteral("máy chủ trả lời mã HTTP %1").arg(detail);
        case FetchProblem::NotHttp:
            return QStringLiteral("máy chủ không trả lời theo HTTP");
        case FetchProblem::TooLarge:
            return QStringLiteral("câu trả lời của máy chủ quá lớn");
        case FetchProblem::TooManyRedirects:
            return QStringLiteral("máy chủ chuyển hướng quá nhiều lần");
        case FetchProblem::RedirectRefused:
            return QStringLiteral("máy chủ chuyển sang một địa chỉ không được phép");
        case FetchProblem::BadHost:
            return QStringLiteral("địa chỉ máy chủ cập nhật không hợp lệ");
        case FetchProblem::Other:
            break;
    }
    return QStringLiteral("lỗi mạng (mã %1)").arg(detail);
}

}  // namespace kickvane::shell
