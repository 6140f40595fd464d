#include "views/accessibility/AXRowRendering.h"

#include <cmath>
#include <utility>

#include "model/LogCategory.h"
#include "platform/base/MainLoop.h"
#include "platform/base/Platform.h"
#include "platform/ui/Device.h"

namespace ktr {

using platform::LogLevel;
using platform::Platform;

namespace {

// The measures of a row do not match each other: the text is measured 10 points wider than it is rendered, with another
// padding. They are as they are meant to be; the host gives a row the room that its image needs.
constexpr double kMargins = 30.0;
constexpr double kMeasuredMargins = 20.0;
constexpr double kLineFragmentPadding = 5.0;
constexpr double kExclusionWidth = 67.0;
constexpr double kExclusionHeight = 54.0;
/// Of the exclusion's left edge from the row's right one, from right to left.
constexpr double kExclusionFromRight = 13.0 + 30.0 + 54.0;
/// What two layouts of one width may differ by.
constexpr double kSameWidth = 1e-6;

double mainScreenScale() {
    const auto installed = Platform::installed();
    return installed && installed->device ? installed->device->mainScreenScale() : 1.0;
}

}  // namespace

bool AXRowRendering::initForRow(const KTRVelaBaseView& row) {
    imageView_ = platform::create<platform::ImageView>(&platform::ImageView::initWithFrame, platform::Rect{});
    // Until a new width has its image, the old one stands where the text begins.
    imageView_->setContentMode(row.isRTLUI() ? platform::ContentMode::TopRight : platform::ContentMode::TopLeft);
    imageView_->setTranslatesAutoresizingMaskIntoConstraints(false);
    imageView_->awaitImage();
    renderer_ = platform::StyledTextRenderer::make();
    return true;
}

std::vector<platform::Rect> AXRowRendering::exclusionPaths(const KTRVelaBaseView& row) {
    const double x = row.isRTLUI() ? row.frame().width - kExclusionFromRight : 0.0;
    return {{x, 0.0, kExclusionWidth, kExclusionHeight}};
}

double AXRowRendering::measuredHeight(const KTRVelaBaseView& row, const platform::AttributedString& text) {
    const double height = row.sizeForText(text, row.frame().width - kMeasuredMargins, exclusionPaths(row)).height;
    return height + kMargins + 1.0 / mainScreenScale();
}

double AXRowRendering::widthFor(const KTRVelaBaseView& row) const {
    const double laidOut = imageView_ ? imageView_->frame().width : 0.0;
    return laidOut > 0.0 ? laidOut : row.frame().width - kMargins;
}

bool AXRowRendering::isDue(const KTRVelaBaseView& row) const {
    const double width = widthFor(row);
    return width_ && width > 0.0 && std::abs(width - *width_) > kSameWidth;
}

void AXRowRendering::render(const KTRVelaBaseView& row, AXRowTexts texts, std::vector<platform::Rect> exclusionPaths) {
    const auto installed = Platform::installed();
    if (!installed || !installed->mainLoop) {
        return;
    }
    LogCategory_Unspecified()->write(LogLevel::Debug, "Generating image for AX view.");
    Input input{std::move(texts), widthFor(row), {}};
    width_ = input.width > 0.0 ? input.width : 0.0;
    if (!(input.width > 0.0)) {
        return;
    }
    input.options.lineFragmentPadding = kLineFragmentPadding;
    input.options.exclusionPaths = std::move(exclusionPaths);
    input.options.rightToLeft = input.texts.rightToLeft;
    input.options.scale = mainScreenScale();
    // The loop outlives the work that it runs, and must not be ended by it.
    installed->mainLoop->runInBackground([asked = std::move(input), renderer = renderer_, last = last_,
                                          generation = ++started_, loop = installed->mainLoop.get(),
                                          self = platform::weak(this), target = platform::weak(&row)] {
        const bool isKnown = last && last->image && last->input == asked;
        auto rendered = std::make_shared<Rendered>();
        if (isKnown) {
            rendered->image = last->image;
        } else if (renderer) {
            rendered->image = renderer->image(asked.texts.composed(), asked.width, asked.options);
        }
        rendered->input = asked;
        loop->post([generation, rendered = std::move(rendered), self, target] {
            const auto rendering = self.lock();
            const auto shownIn = target.lock();
            if (rendering && shownIn && Platform::installed()) {
                rendering->install(*shownIn, generation, rendered);
            }
        });
    });
}

void AXRowRendering::install(const KTRVelaBaseView& row, std::uint64_t generation,
                             std::shared_ptr<const Rendered> rendered) {
    LogCategory_Unspecified()->write(LogLevel::Debug, "Image generated - %i", rendered->image ? 1 : 0);
    if (generation < installed_) {
        return;
    }
    installed_ = generation;
    last_ = std::move(rendered);
    if (imageView_) {
        imageView_->setImage(last_->image);
    }
    if (const auto delegate = row.viewDelegate()) {
        delegate->viewNeedsResize();
    }
}

}  // namespace ktr
