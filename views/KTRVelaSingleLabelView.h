#pragma once

#include <memory>
#include <optional>
#include <string>

#include "platform/ui/Label.h"
#include "views/KTRVelaBaseView.h"

namespace ktr {

/// A row of one wrapped text: a message ("locating ..."), or the row that opens the list of all friends. Main thread.
class KTRVelaSingleLabelView : public KTRVelaBaseView {
  public:
    bool initWithFrame(const platform::Rect& frame) override;

    const std::string& labelText() const { return labelText_; }
    /// Shows the text, centred when `isShowAll` is set at this moment, else at the language's leading edge.
    void setLabelText(const std::string& text);
    /// The row opens the friend list. Setting it does not realign the text that is shown already.
    bool isShowAll() const { return isShowAll_; }
    void setIsShowAll(bool isShowAll) { isShowAll_ = isShowAll; }
    std::shared_ptr<platform::Label> label() const { return label_; }
    void setLabel(std::shared_ptr<platform::Label> label) { label_ = std::move(label); }

    /// "wayloc://friends/" of a show-all row, none of a message.
    std::optional<platform::Url> urlForTouch() override;
    /// The text's height at the frame's width without the margins, and the two margins of 15 points.
    double estimagedHeightForView() override;
    platform::AccessibilityRole accessibilityRole() const override;

  private:
    std::string labelText_;
    bool isShowAll_ = false;
    std::shared_ptr<platform::Label> label_;
};

}  // namespace ktr
