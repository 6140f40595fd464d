#include "linux/net/OneShotBody.h"

#include <algorithm>
#include <cstring>
#include <utility>

namespace ktr::linux_ {

OneShotBody::OneShotBody(QByteArray body, QObject* parent) : QIODevice(parent), body_(std::move(body)) {
    open(QIODevice::ReadOnly | QIODevice::Unbuffered);
}

qint64 OneShotBody::readData(char* data, qint64 maximum) {
    const qint64 count = std::min<qint64>(maximum, body_.size() - at_);
    if (count <= 0) {
        return -1;
    }
    std::memcpy(data, body_.constData() + at_, static_cast<std::size_t>(count));
    at_ += count;
    return count;
}

qint64 OneShotBody::writeData(const char* /*data*/, qint64 /*size*/) {
    return -1;
}

}  // namespace ktr::linux_
