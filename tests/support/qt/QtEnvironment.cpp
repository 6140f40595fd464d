#include <gtest/gtest.h>

#include <QGuiApplication>
#include <memory>

#include "linux/paint/FontSetup.h"

// Programs that link this have an application with the pinned fonts while their tests run.

namespace ktr::test {

namespace {

class QtEnvironment : public ::testing::Environment {
  public:
    void SetUp() override {
        if (QCoreApplication::instance() != nullptr) {
            return;
        }
        qputenv("QT_QPA_PLATFORM", "offscreen");
        std::string error;
        ASSERT_TRUE(linux_::FontSetup::prepare(linux_::FontSetup::Mode::Pinned, &error)) << error;
        application_ = std::make_unique<QGuiApplication>(argumentCount_, arguments_);
        for (const auto& missing : linux_::FontSetup::load(linux_::FontSetup::Mode::Pinned)) {
            ADD_FAILURE() << "missing font file: " << missing;
        }
    }
    void TearDown() override { application_.reset(); }

  private:
    int argumentCount_ = 1;
    char name_[5] = "test";
    char* arguments_[2] = {name_, nullptr};
    std::unique_ptr<QGuiApplication> application_;
};

// gtest owns it from here on.
const auto* const kEnvironment = ::testing::AddGlobalTestEnvironment(new QtEnvironment);

}  // namespace

}  // namespace ktr::test
