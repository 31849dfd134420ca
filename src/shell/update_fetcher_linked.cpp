// The update check's network code linked into the program (the Windows program, the tests).
#include "shell/update_check.h"

namespace kickvane::shell {

std::unique_ptr<UpdateFetcher> makeUpdateFetcher(const UpdateFetchOptions& options,
                                                 UpdateFetcher::Done done, QString&) {
    return createUpdateFetcher(options, std::move(done));
}

}  // namespace kickvane::shell
