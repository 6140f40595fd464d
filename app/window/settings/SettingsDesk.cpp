#include "app/window/settings/SettingsDesk.h"

#include <utility>

namespace ktr::app {

void SettingsDesk::change(Changes changes, Done done) {
    waiting_.push_back({std::move(changes), std::move(done)});
    if (waiting_.size() == 1) {
        writeNext();
    }
}

void SettingsDesk::writeNext() {
    aside_.run([this, file = file_, changes = waiting_.front().changes]() -> linux_::Aside::Then {
        return [this, problem = linux_::ConfigurationFile(file).change(changes)] {
            const Wish written = std::move(waiting_.front());
            waiting_.pop_front();
            if (!waiting_.empty()) {
                writeNext();
            }
            written.done(problem);
        };
    });
}

}  // namespace ktr::app
