#pragma once

#include <QNetworkReply>
#include <QString>

// Why a fetch from the update host failed, in the words of the tool's Vietnamese interface. Qt's
// own reasons are English; the user reads these after "Không kiểm tra được phiên bản mới: ".
namespace kickvane::shell {

enum class FetchProblem {
    TimedOut,
    HostNotFound,
    ConnectionRefused,
    ConnectionClosed,
    SecureConnection,  // TLS/SSL handshake
    NoNetwork,
    Proxy,
    HttpStatus,  // an answer with an error status; its code is the detail
    NotHttp,
    TooLarge,
    TooManyRedirects,
    RedirectRefused,  // to another host, port or scheme
    BadHost,          // the configured address is no web address
    Other,            // anything else; Qt's error code is the detail
};

// The problem behind one of Qt's network errors.
FetchProblem problemOf(QNetworkReply::NetworkError error);

// The text of a problem; `detail` is the HTTP status, or Qt's error code for Other.
QString fetchProblemText(FetchProblem problem, int detail = 0);

inline QString networkErrorText(QNetworkReply::NetworkError error) {
    return fetchProblemText(problemOf(error), static_cast<int>(error));
}

}  // namespace kickvane::shell
