#include "linux/net/NetworkThread.h"

#include <QMetaObject>
#include <utility>

namespace ktr::linux_ {

NetworkThread::NetworkThread() : context_(new QObject) {
    context_->moveToThread(&thread_);
    thread_.setObjectName(QStringLiteral("ktr network"));
    QObject::connect(&thread_, &QThread::finished, context_, &QObject::deleteLater);
    thread_.start();
}

NetworkThread::~NetworkThread() {
    post([this] { thread_.quit(); });
    thread_.wait();
}

void NetworkThread::post(std::function<void()> work) {
    QMetaObject::invokeMethod(context_, std::move(work), Qt::QueuedConnection);
}

void NetworkThread::run(const std::function<void()>& work) {
    if (QThread::currentThread() == &thread_) {
        work();
        return;
    }
    QMetaObject::invokeMethod(context_, work, Qt::BlockingQueuedConnection);
}

}  // namespace ktr::linux_
