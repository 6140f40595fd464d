#pragma once

#include <memory>
#include <vector>

#include "platform/ui/View.h"

namespace ktr::platform {

/// Places its arranged subviews one under the other, each as wide as the stack and as high as it fits at that width;
/// what height is left goes to the last one, or to all of them alike. Hidden ones take no room. A subview that is not
/// arranged is neither laid out, painted, hit nor spoken. No solver: cost is linear in what changed. Main thread.
class KTR_API StackView : public View {
  public:
    enum class Axis { Horizontal, Vertical };
    enum class Distribution { FillLast, FillEvenly };

    Axis axis() const { return axis_; }
    /// Vertical is the one arrangement there is; the axis is kept as it was set.
    void setAxis(Axis axis) { axis_ = axis; }
    /// Who has the height that is left. FillLast to begin with.
    Distribution distribution() const { return distribution_; }
    void setDistribution(Distribution distribution);
    const std::vector<std::shared_ptr<View>>& arrangedSubviews() const { return arranged_; }
    void addArrangedSubview(const std::shared_ptr<View>& view);
    /// A view that is arranged already is moved; the index counts without it. An index beyond the end appends.
    void insertArrangedSubview(const std::shared_ptr<View>& view, std::size_t index);
    /// Takes the view out of the arrangement; it stays a subview.
    void removeArrangedSubview(const std::shared_ptr<View>& view);

    /// The whole arrangement in one step, at a cost linear in its length. A view that comes again is left out at its
    /// later places; a view that is arranged no longer stays a subview. What is arranged so already costs nothing.
    void setArrangedSubviews(const std::vector<std::shared_ptr<View>>& views);

    const std::vector<std::shared_ptr<View>>& presentedSubviews() const override { return arranged_; }
    void layoutSubviews() override;
    Size systemLayoutSizeFitting(const Size& target, double horizontalPriority, double verticalPriority) override;

  protected:
    void subviewsChanged() override;
    void subviewInputChanged(const View& subview) override;
    std::pair<std::size_t, std::size_t> presentedWithin(const Rect& rect) const override;

  private:
    void arrangementChanged();
    void readHeights(double width);
    /// What every subview has of the room that is left; 0 where the last one has it all.
    double evenShare(double height) const;
    double heightOf(std::size_t index, double width) const;

    Axis axis_ = Axis::Vertical;
    Distribution distribution_ = Distribution::FillLast;
    std::vector<std::shared_ptr<View>> arranged_;
    std::size_t knownSubviews_ = 0;
    /// By arranged subview: what it needs at `width_`; kHidden for one that takes no room.
    std::vector<double> heights_;
    double width_ = 0.0;
    double used_ = 0.0;
    /// Whose heights have to be asked for again: these only, or all.
    std::vector<const View*> changed_;
    bool areAllChanged_ = true;
    /// The first whose place is not known to be right for heights_.
    std::size_t misplaced_ = 0;
    /// The last that takes room, which has what room is left.
    std::size_t last_ = 0;
    Size placedFor_{-1.0, -1.0};
    double placedShare_ = 0.0;
    bool hasHidden_ = false;
};

}  // namespace ktr::platform
