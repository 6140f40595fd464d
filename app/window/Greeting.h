#pragma once

#include <functional>
#include <string>
#include <vector>

#include "app/window/blocks/Flow.h"
#include "app/window/blocks/Picture.h"
#include "app/window/blocks/Pill.h"
#include "app/window/blocks/Words.h"
#include "host/Host.h"

namespace ktr::app {

/// What stands in an empty conversation: a greeting by the time of day, and questions that a tap asks. Main thread.
class Greeting : public Block {
  public:
    /// The host outlives it.
    explicit Greeting(const host::Host& host, QWidget* parent = nullptr);

    /// Called with the question that was tapped.
    void setAsked(std::function<void(const std::string&)> asked) { asked_ = std::move(asked); }
    /// The hour of the day, from 0, by which it greets.
    void setHour(int hour);
    const std::vector<UnaskedQuestion*>& questions() const { return questions_; }

    /// As high as the conversation that it stands in.
    int shapeHeight(int /*width*/) const override { return height(); }

  protected:
    void resizeEvent(QResizeEvent* event) override;
    bool event(QEvent* event) override;
    void refreshed() override;

  private:
    QString text(const char* key) const;
    void place();

    const host::Host& host_;
    std::function<void(const std::string&)> asked_;
    int hour_ = 0;
    Picture* icon_;
    Words* title_;
    Words* line_;
    Flow* flow_;
    std::vector<UnaskedQuestion*> questions_;
};

}  // namespace ktr::app
