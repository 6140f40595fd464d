#include <QCoreApplication>
#include <QDeadlineTimer>
#include <QEventLoop>
#include <QTimer>

#include "linux/device/QtMainLoop.h"
#include "tests/contract/MainLoopContract.h"

namespace ktr::test {

namespace {

bool runQtUntil(const std::function<bool()>& condition, double seconds) {
    const auto milliseconds = static_cast<int>(seconds * 1000.0);
    const QDeadlineTimer deadline(milliseconds);
    // Wakes the loop at the deadline if nothing else does.
    QTimer waker;
    waker.setSingleShot(true);
    waker.start(milliseconds);
    while (!condition()) {
        if (deadline.hasExpired()) {
            return false;
        }
        QCoreApplication::processEvents(QEventLoop::WaitForMoreEvents);
        QCoreApplication::sendPostedEvents(nullptr, QEvent::DeferredDelete);
    }
    return true;
}

}  // namespace

INSTANTIATE_TEST_SUITE_P(QtMainLoop, MainLoopContract,
                         ::testing::Values(MainLoopCase{
                             "QtMainLoop",
                             [] {
                                 return MainLoopUnderTest{std::make_shared<linux_::QtMainLoop>(), runQtUntil};
                             }}),
                         caseName);

}  // namespace ktr::test
