#include "platform/module.h"

#include <gtest/gtest.h>

#include "support/temp_dir.h"

namespace kickvane::platform {
namespace {

// A broken or missing module is reported with the loader's reason, not a later, vaguer one.
TEST(Module, ThatCannotLoadKeepsTheLoadersReason) {
    testing::TempDir dir;
    testing::WriteFile(dir / "broken.so", "not a library");
    Module broken(dir / "broken.so");
    EXPECT_EQ(broken.Find("anything"), nullptr);
    EXPECT_NE(broken.error().find("broken.so"), std::string::npos) << broken.error();

    Module libc("libc.so.6");
    EXPECT_NE(libc.Find("strlen"), nullptr);
    EXPECT_EQ(libc.Find("no_such_symbol_here"), nullptr);
    EXPECT_NE(libc.error().find("no_such_symbol_here"), std::string::npos) << libc.error();
}

}  // namespace
}  // namespace kickvane::platform
