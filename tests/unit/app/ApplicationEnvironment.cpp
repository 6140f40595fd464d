#include <gtest/gtest.h>

#include <QApplication>
#include <memory>

#include "linux/paint/FontSetup.h"

// The tests of the program have an application for widgets, off screen and with the pinned fonts.

namespace ktr::test {

namespace {

class ApplicationEnvironment : public ::testing::Environment {
  public:
    void SetUp() override {
        qputenv("QT_QPA_PLATFORM", "offscreen");
        std::string error;
        ASSERT_TRUE(linux_::FontSetup::prepare(linux_::FontSetup::Mode::Pinned, &error)) << error;
        application_ = std::make_unique<QApplication>(argumentCount_, arguments_);
        EXPECT_TRUE(linux_::FontSetup::load(linux_::FontSetup::Mode::Pinned).empty());
    }
    void TearDown() override { application_.reset(); }

  private:
    int argumentCount_ = 1;
    char name_[5] = "test";
    char* arguments_[2] = {name_, nullptr};
    std::unique_ptr<QApplication> application_;
};

// gtest owns it from here on.
const auto* const kEnvironment = ::testing::AddGlobalTestEnvironment(new ApplicationEnvironment);

}  // namespace

}  // namespace ktr::test
