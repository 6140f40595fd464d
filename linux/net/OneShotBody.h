#pragma once

#include <QByteArray>
#include <QIODevice>

namespace ktr::linux_ {

/// A request body that can be read once: it neither seeks nor resets, so that the network library, which would
/// otherwise send a POST again when its connection breaks, has nothing to send it again from.
class OneShotBody : public QIODevice {
  public:
    explicit OneShotBody(QByteArray body, QObject* parent = nullptr);

    bool isSequential() const override { return true; }
    bool reset() override { return false; }
    bool atEnd() const override { return at_ >= body_.size(); }
    qint64 bytesAvailable() const override { return body_.size() - at_; }

  protected:
    qint64 readData(char* data, qint64 maximum) override;
    qint64 writeData(const char* data, qint64 size) override;

  private:
    QByteArray body_;
    qint64 at_ = 0;
};

}  // namespace ktr::linux_
