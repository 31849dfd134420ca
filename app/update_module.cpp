// The update check's network code behind a C entry point, in a module of its own that the
// window's module loads for the first check.
#include "shell/update_check.h"

extern "C" __attribute__((visibility("default"))) kickvane::shell::UpdateFetcher*
kickvane_create_update_fetcher(const kickvane::shell::UpdateFetchOptions* options,
                               const kickvane::shell::UpdateFetcher::Done* done) {
    return kickvane::shell::createUpdateFetcher(*options, *done).release();
}
