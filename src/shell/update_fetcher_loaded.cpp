// The update check's network code in a module beside the window's module, loaded by the first
// check: Qt Network and the libraries it brings stay out of a window that never checks.
#include "platform/module.h"
#include "shell/qt_text.h"
#include "shell/update_fetcher.h"

namespace kickvane::shell {

std::unique_ptr<UpdateFetcher> makeUpdateFetcher(const UpdateFetchOptions& options,
                                                 UpdateFetcher::Done done, QString& error) {
    static platform::Module module(
        platform::FileHolding(reinterpret_cast<const void*>(&makeUpdateFetcher)).parent_path() /
        KICKVANE_UPDATE_MODULE_NAME);
    using Create = UpdateFetcher* (*)(const UpdateFetchOptions*, const UpdateFetcher::Done*);
    const auto create = reinterpret_cast<Create>(module.Find("kickvane_create_update_fetcher"));
    if (!create) {
        error = QStringLiteral("không nạp được phần kết nối mạng của công cụ (%1)")
                    .arg(toQString(module.error()));
        return nullptr;
    }
    return std::unique_ptr<UpdateFetcher>(create(&options, &done));
}

}  // namespace kickvane::shell
