#include "linux/device/Aside.h"

#include <mutex>
#include <thread>
#include <utility>

namespace ktr::linux_ {

struct Aside::Return {
    std::mutex mutex;
    QObject* owner = nullptr;  ///< none once it has gone
};

Aside::Aside(QObject& owner) : return_(std::make_shared<Return>()) {
    return_->owner = &owner;
}

Aside::~Aside() {
    const std::lock_guard lock(return_->mutex);
    return_->owner = nullptr;
}

void Aside::run(std::function<Then()> work) {
    std::thread([back = return_, work = std::move(work)] {
        auto then = work();
        const std::lock_guard lock(back->mutex);
        if (back->owner != nullptr) {
            // What an object still has to be told goes with it.
            QMetaObject::invokeMethod(back->owner, std::move(then), Qt::QueuedConnection);
        }
    }).detach();
}

}  // namespace ktr::linux_
