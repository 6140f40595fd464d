#include "platform/layout/VisualFormat.h"

#include <cmath>

#include "platform/base/Log.h"
#include "platform/base/Platform.h"
#include "platform/layout/VisualFormatParser.h"
#include "platform/ui/View.h"

namespace ktr::platform {

namespace {

using Syntax = VisualFormatSyntax;

struct Alignment {
    VisualFormatAlignment option;
    LayoutAttribute attribute;
    LayoutAxis formatAxis;  // of the formats that it suits
};

constexpr Alignment kAlignments[] = {
    {VisualFormatAlignment::Leading, LayoutAttribute::Leading, LayoutAxis::Vertical},
    {VisualFormatAlignment::Trailing, LayoutAttribute::Trailing, LayoutAxis::Vertical},
    {VisualFormatAlignment::Left, LayoutAttribute::Left, LayoutAxis::Vertical},
    {VisualFormatAlignment::Right, LayoutAttribute::Right, LayoutAxis::Vertical},
    {VisualFormatAlignment::CenterX, LayoutAttribute::CenterX, LayoutAxis::Vertical},
    {VisualFormatAlignment::Top, LayoutAttribute::Top, LayoutAxis::Horizontal},
    {VisualFormatAlignment::Bottom, LayoutAttribute::Bottom, LayoutAxis::Horizontal},
    {VisualFormatAlignment::CenterY, LayoutAttribute::CenterY, LayoutAxis::Horizontal},
    {VisualFormatAlignment::FirstBaseline, LayoutAttribute::FirstBaseline, LayoutAxis::Horizontal},
    {VisualFormatAlignment::LastBaseline, LayoutAttribute::LastBaseline, LayoutAxis::Horizontal},
};

/// Makes the constraints of one format, looking its names up. The views stay alive in `views`.
class Builder {
  public:
    Builder(std::string_view text, const Syntax& syntax, VisualFormatOptions options,
            const VisualFormatMetrics& metrics, const VisualFormatViews& views, std::vector<ConstraintRule>& rules)
        : text_(text), syntax_(syntax), options_(options), metrics_(metrics), views_(views), rules_(rules) {
        setEdges();
    }

    /// Appends the rules; none when there is an error.
    void build() {
        const std::size_t before = rules_.size();
        if (!findViews() || !addItems() || !addAlignments()) {
            rules_.resize(before);
        }
    }
    const std::optional<VisualFormatError>& error() const { return error_; }

  private:
    bool isHorizontal() const { return syntax_.axis == LayoutAxis::Horizontal; }

    bool fail(std::size_t offset, std::string expected) {
        error_ = VisualFormatParser::errorAt(text_, offset, std::move(expected));
        return false;
    }

    void setEdges() {
        if (!isHorizontal()) {
            near_ = LayoutAttribute::Top;
            far_ = LayoutAttribute::Bottom;
        } else if (options_.direction == VisualFormatDirection::LeadingToTrailing) {
            near_ = LayoutAttribute::Leading;
            far_ = LayoutAttribute::Trailing;
        } else {
            near_ = LayoutAttribute::Left;
            far_ = LayoutAttribute::Right;
        }
        isBackwards_ = isHorizontal() && options_.direction == VisualFormatDirection::RightToLeft;
    }

    bool findViews() {
        items_.reserve(syntax_.items.size());
        for (const Syntax::Item& item : syntax_.items) {
            View* const view = viewNamed(item.view.text);
            if (!view) {
                return fail(item.view.offset, "no view is named '" + std::string(item.view.text) + "'");
            }
            items_.push_back(view);
        }
        return findSuperview(syntax_.leadingEdge, *items_.front(), syntax_.items.front(), before_) &&
               findSuperview(syntax_.trailingEdge, *items_.back(), syntax_.items.back(), behind_);
    }

    bool findSuperview(const std::optional<std::size_t>& edge, const View& view, const Syntax::Item& item,
                       std::shared_ptr<View>& superview) {
        if (!edge) {
            return true;
        }
        superview = view.superview();
        return superview || fail(*edge, "the view '" + std::string(item.view.text) + "' has no superview");
    }

    View* viewNamed(std::string_view name) const {
        const auto found = views_.find(name);
        return found == views_.end() ? nullptr : found->second.get();
    }

    bool addItems() {
        for (std::size_t i = 0; i < items_.size(); ++i) {
            const Syntax::Item& item = syntax_.items[i];
            View& view = *items_[i];
            if (i > 0) {
                if (!addGap(item.before, items_[i - 1]->anchor(far_), view.anchor(near_), false)) {
                    return false;
                }
            } else if (syntax_.leadingEdge) {
                if (!addGap(item.before, before_->anchor(near_), view.anchor(near_), true)) {
                    return false;
                }
            }
            if (!addSizes(item, view)) {
                return false;
            }
        }
        return !syntax_.trailingEdge || addGap(syntax_.last, items_.back()->anchor(far_), behind_->anchor(far_), true);
    }

    /// second = first + gap, or, from right to left, the same with all edges turned round.
    bool addGap(const Syntax::Connection& connection, LayoutAnchor first, LayoutAnchor second, bool isToSuperview) {
        if (isBackwards_) {
            const LayoutAnchor before = first;
            first = turned(second);
            second = turned(before);
        }
        if (!connection || connection->empty()) {
            const double standard = isToSuperview ? VisualFormat::kSpaceToSuperview : VisualFormat::kSpaceBetweenViews;
            add(second, LayoutRelation::Equal, first, connection ? standard : 0.0, kRequiredPriority);
            return true;
        }
        for (const Syntax::Predicate& predicate : *connection) {
            double gap = 0.0;
            double priority = kRequiredPriority;
            if (!readNumber(predicate.object, gap) || !readPriority(predicate, priority)) {
                return false;
            }
            add(second, predicate.relation, first, gap, priority);
        }
        return true;
    }

    static LayoutAnchor turned(const LayoutAnchor& anchor) {
        return {anchor.reference(),
                anchor.attribute() == LayoutAttribute::Left ? LayoutAttribute::Right : LayoutAttribute::Left};
    }

    bool addSizes(const Syntax::Item& item, View& view) {
        const LayoutAttribute extent = isHorizontal() ? LayoutAttribute::Width : LayoutAttribute::Height;
        for (const Syntax::Predicate& predicate : item.sizes) {
            double priority = kRequiredPriority;
            if (!readPriority(predicate, priority)) {
                return false;
            }
            const auto* name = std::get_if<Syntax::Name>(&predicate.object);
            if (name && metrics_.find(name->text) == metrics_.end()) {
                View* const other = viewNamed(name->text);
                if (!other) {
                    return fail(name->offset, "no metric or view is named '" + std::string(name->text) + "'");
                }
                add(view.anchor(extent), predicate.relation, other->anchor(extent), 0.0, priority);
                continue;
            }
            double size = 0.0;
            if (!readNumber(predicate.object, size)) {
                return false;
            }
            rules_.push_back(
                {ViewReference(view), {}, {extent, LayoutAttribute::None, predicate.relation, 0.0, size, priority}});
        }
        return true;
    }

    bool addAlignments() {
        for (const Alignment& alignment : kAlignments) {
            if ((static_cast<unsigned>(options_.alignment) & static_cast<unsigned>(alignment.option)) == 0) {
                continue;
            }
            if (alignment.formatAxis != syntax_.axis) {
                return fail(0, isHorizontal() ? "a horizontal format cannot align its views horizontally"
                                              : "a vertical format cannot align its views vertically");
            }
            for (std::size_t i = 1; i < items_.size(); ++i) {
                add(items_[i]->anchor(alignment.attribute), LayoutRelation::Equal,
                    items_[i - 1]->anchor(alignment.attribute), 0.0, kRequiredPriority);
            }
        }
        return true;
    }

    bool readNumber(const Syntax::Operand& operand, double& number) {
        if (const auto* literal = std::get_if<Syntax::Number>(&operand)) {
            number = literal->value;
            return true;
        }
        const auto& name = std::get<Syntax::Name>(operand);
        const auto found = metrics_.find(name.text);
        if (found == metrics_.end()) {
            return fail(name.offset, "no metric is named '" + std::string(name.text) + "'");
        }
        number = found->second;
        return std::isfinite(number) ||
               fail(name.offset, "the metric '" + std::string(name.text) + "' is not a finite number");
    }

    bool readPriority(const Syntax::Predicate& predicate, double& priority) {
        if (!predicate.priority) {
            return true;
        }
        const auto* name = std::get_if<Syntax::Name>(&*predicate.priority);
        const std::size_t offset = name ? name->offset : std::get<Syntax::Number>(*predicate.priority).offset;
        return readNumber(*predicate.priority, priority) && ((priority >= 1.0 && priority <= kRequiredPriority) ||
                                                             fail(offset, "expected a priority from 1 to 1000"));
    }

    void add(const LayoutAnchor& first, LayoutRelation relation, const LayoutAnchor& second, double constant,
             double priority) {
        rules_.push_back({first.reference(),
                          second.reference(),
                          {first.attribute(), second.attribute(), relation, 1.0, constant, priority}});
    }

    std::string_view text_;
    const Syntax& syntax_;
    VisualFormatOptions options_;
    const VisualFormatMetrics& metrics_;
    const VisualFormatViews& views_;
    LayoutAttribute near_ = LayoutAttribute::Leading;
    LayoutAttribute far_ = LayoutAttribute::Trailing;
    bool isBackwards_ = false;
    std::vector<View*> items_;
    /// Of the first view and of the last one, where the format says "|".
    std::shared_ptr<View> before_;
    std::shared_ptr<View> behind_;
    std::vector<ConstraintRule>& rules_;
    std::optional<VisualFormatError> error_;
};

/// The formats of programs, taken apart once. One for each installed platform. Main thread.
class KnownFormats {
  public:
    struct Format {
        std::string text;  // the syntax points into it
        std::optional<Syntax> syntax;
        std::optional<VisualFormatError> error;
    };

    static std::shared_ptr<KnownFormats> makeShared() { return std::make_shared<KnownFormats>(); }

    /// `known` may be none: nothing is kept then.
    static std::shared_ptr<const Format> parsed(KnownFormats* known, std::string_view text) {
        if (!known) {
            return parse(text);
        }
        if (const auto found = known->formats_.find(text); found != known->formats_.end()) {
            return found->second;
        }
        if (known->formats_.size() == kMost) {
            known->formats_.clear();
        }
        auto format = parse(text);
        known->formats_.emplace(format->text, format);
        return format;
    }

  private:
    // A program has a few dozen formats; a text that changes with each call must not fill the memory.
    static constexpr std::size_t kMost = 256;

    static std::shared_ptr<const Format> parse(std::string_view text) {
        auto format = std::make_shared<Format>();
        format->text = text;
        VisualFormatParser parser(format->text);
        format->syntax = parser.parse();
        format->error = parser.error();
        return format;
    }

    std::map<std::string, std::shared_ptr<const Format>, std::less<>> formats_;
};

}  // namespace

std::string VisualFormatError::message() const {
    return "column " + std::to_string(column) + ": " + expected;
}

namespace {

/// Appends the rules of a format; the error where there is one.
std::optional<VisualFormatError> appendRules(KnownFormats* formats, std::string_view format,
                                             VisualFormatOptions options, const VisualFormatMetrics& metrics,
                                             const VisualFormatViews& views, std::vector<ConstraintRule>& rules) {
    const auto known = KnownFormats::parsed(formats, format);
    if (!known->syntax) {
        return known->error;
    }
    Builder builder(known->text, *known->syntax, options, metrics, views, rules);
    builder.build();
    return builder.error();
}

void logError(std::string_view format, const VisualFormatError& error) {
    platformLog().write(LogLevel::Error, "The visual format %@ is wrong at %@",
                        FormatArgument(std::string(format)).shown(), FormatArgument(error.message()).shown());
}

}  // namespace

VisualFormatResult VisualFormat::parse(std::string_view format, VisualFormatOptions options,
                                       const VisualFormatMetrics& metrics, const VisualFormatViews& views) {
    VisualFormatResult result;
    std::vector<ConstraintRule> rules;
    result.error = appendRules(shared<KnownFormats>().get(), format, options, metrics, views, rules);
    for (ConstraintRule& rule : rules) {
        result.constraints.push_back(std::make_shared<LayoutConstraint>(std::move(rule)));
    }
    return result;
}

std::vector<std::shared_ptr<LayoutConstraint>> VisualFormat::constraintsWithVisualFormat(
    std::string_view format, VisualFormatOptions options, const VisualFormatMetrics& metrics,
    const VisualFormatViews& views) {
    VisualFormatResult result = parse(format, options, metrics, views);
    if (result.error) {
        logError(format, *result.error);
    }
    return std::move(result.constraints);
}

void VisualFormat::addConstraints(View& view, std::span<const Picture> pictures, const VisualFormatMetrics& metrics,
                                  const VisualFormatViews& views) {
    constexpr std::size_t kRulesOfAPicture = 4;
    const auto formats = shared<KnownFormats>();
    std::vector<ConstraintRule> rules;
    rules.reserve(kRulesOfAPicture * pictures.size());
    for (const Picture& picture : pictures) {
        if (const auto error = appendRules(formats.get(), picture.format, picture.options, metrics, views, rules)) {
            logError(picture.format, *error);
        }
    }
    view.addRules(rules);
}

}  // namespace ktr::platform
