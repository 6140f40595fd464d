#include "linux/configuration/SecretModule.h"

#include <QDBusConnectionInterface>
#include <QProcess>
#include <memory>

#include "linux/device/LoadableModule.h"
#include "tests/support/TemporaryFolder.h"
#include "tests/support/qt/PrivateBus.h"

namespace ktr::test {

class SecretModuleTest : public ::testing::Test {
  protected:
    void SetUp() override {
        std::string error;
        void* entry = linux_::LoadableModule::entry("libktr-secret.so", linux_::kSecretModuleEntry, error);
        ASSERT_NE(entry, nullptr) << error;
        module.reset(reinterpret_cast<linux_::SecretModuleEntry>(entry)());
        ASSERT_NE(module, nullptr);
    }
    /// Runs a program to its end with this text as its input.
    static int run(const QString& program, const QStringList& arguments, const QByteArray& input) {
        QProcess process;
        process.start(program, arguments);
        process.write(input);
        process.closeWriteChannel();
        return process.waitForFinished(20000) ? process.exitCode() : -1;
    }

    std::unique_ptr<linux_::SecretModule> module;
};

// One test, since a process keeps its first session bus.
TEST_F(SecretModuleTest, WithoutABus_AnError_WithAKeyring_TheToken) {
    qputenv("DBUS_SESSION_BUS_ADDRESS", "unix:path=/nonexistent/bus");
    std::string error;
    EXPECT_EQ(module->lookUp("7", "f.example", 5.0, false, error), std::nullopt);
    EXPECT_FALSE(error.empty());
    error.clear();
    EXPECT_FALSE(module->store("7", "f.example", "s3cret", 5.0, false, error));
    EXPECT_FALSE(error.empty()) << "what is not kept has a reason";

    const TemporaryFolder home;
    const PrivateBus bus;
    qputenv("DBUS_SESSION_BUS_ADDRESS", bus.address().toUtf8());
    qputenv("XDG_DATA_HOME", home.path().c_str());
    qputenv("XDG_RUNTIME_DIR", home.path().c_str());
    QProcess keyring;
    keyring.start(QStringLiteral("gnome-keyring-daemon"),
                  {QStringLiteral("--foreground"), QStringLiteral("--unlock"), QStringLiteral("--components=secrets")});
    ASSERT_TRUE(keyring.waitForStarted());
    keyring.write("password");
    keyring.closeWriteChannel();
    // Whoever asks too early has the bus start another one, which is locked.
    const QDBusConnection watching = bus.connect(QStringLiteral("secrets"));
    EXPECT_TRUE(eventually(
        [&] { return watching.interface()->isServiceRegistered(QStringLiteral("org.freedesktop.secrets")).value(); }));
    PrivateBus::disconnect(QStringLiteral("secrets"));
    const QStringList store{QStringLiteral("store"), QStringLiteral("--label=ktr"), QStringLiteral("application"),
                            QStringLiteral("ktr"),   QStringLiteral("person"),      QStringLiteral("7"),
                            QStringLiteral("host"),  QStringLiteral("f.example")};
    EXPECT_EQ(run(QStringLiteral("secret-tool"), store, "s3cret"), 0);

    error.clear();
    EXPECT_EQ(module->lookUp("7", "f.example", 20.0, false, error), "s3cret");
    EXPECT_EQ(error, "");
    EXPECT_EQ(module->lookUp("8", "f.example", 20.0, false, error), std::nullopt);
    EXPECT_EQ(error, "") << "a missing item is no error";
    EXPECT_TRUE(module->store("8", "f.example", "first", 20.0, false, error)) << error;
    EXPECT_TRUE(module->store("8", "f.example", "second", 20.0, false, error)) << error;
    EXPECT_EQ(module->lookUp("8", "f.example", 20.0, false, error), "second") << "in place of the first";
    EXPECT_EQ(module->lookUp("7", "f.example", 20.0, false, error), "s3cret");
    keyring.terminate();
    EXPECT_TRUE(keyring.waitForFinished(10000));
}

}  // namespace ktr::test
