#include "tests/transport/TransportTest.h"

#include <gtest/gtest.h>

namespace ktr::test {

/// The application and the certificates that the tests of this program share. The application ends before the statics
/// do, as everybody's who looks up names has to (NetworkThread).
class TransportTest::Setting : public ::testing::Environment {
  public:
    void SetUp() override {
        application_ = std::make_unique<QCoreApplication>(argumentCount_, arguments_);
        certificates = std::make_unique<TestCertificates>();
    }
    void TearDown() override {
        certificates.reset();
        application_.reset();
    }

    /// gtest owns it.
    static const ::testing::Environment* const kRegistered;

  private:
    int argumentCount_ = 1;
    char name_[10] = "transport";
    char* arguments_[2] = {name_, nullptr};
    std::unique_ptr<QCoreApplication> application_;
};

const ::testing::Environment* const TransportTest::Setting::kRegistered =
    ::testing::AddGlobalTestEnvironment(new Setting);

}  // namespace ktr::test
