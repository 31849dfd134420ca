#pragma once

#include <gtest/gtest.h>

#include <QtGlobal>
#include <memory>
#include <string>

namespace kickvane::testing {

// One Qt application object (QGuiApplication, QApplication) for all tests of a program, on the
// offscreen platform unless the environment names another.
template <class App>
class QtAppEnvironment : public ::testing::Environment {
public:
    explicit QtAppEnvironment(std::string name) : name_(std::move(name)) {}

    void SetUp() override {
        if (qEnvironmentVariableIsEmpty("QT_QPA_PLATFORM")) {
            qputenv("QT_QPA_PLATFORM", "offscreen");
        }
        app_ = std::make_unique<App>(argc_, argv_);
    }
    void TearDown() override { app_.reset(); }

private:
    std::string name_;
    int argc_ = 1;
    char* argv_[2] = {name_.data(), nullptr};
    std::unique_ptr<App> app_;
};

}  // namespace kickvane::testing
