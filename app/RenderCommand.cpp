#include "app/RenderCommand.h"

#include <algorithm>
#include <cmath>

#include "linux/paint/ScenePainter.h"

namespace ktr::app {

namespace {

using linux_::ColorScheme;
using linux_::Contrast;
using linux_::Palette;
using linux_::QtCanvas;
using linux_::ScenePainter;

/// Paints the part of the window that begins at `top` and is as high as the picture.
ScenePainter::Paint part(const std::shared_ptr<platform::Window>& window, double top, double height) {
    return [window, top, height](QtCanvas& canvas) {
        canvas.save();
        canvas.translate(0.0, -top);
        window->paint(canvas, canvas.seen({0.0, top, window->bounds().width, height}));
        canvas.restore();
    };
}

}  // namespace

std::string RenderCommand::pieceName(const std::string& output, int number) {
    const std::size_t dot = output.rfind('.');
    return output.substr(0, dot) + "-" + std::to_string(number) + output.substr(dot);
}

const Palette& RenderCommand::choosePalette() const {
    const host::HostSettings& settings = host_.settings();
    const Palette& palette = Palette::of(settings.dark.value_or(false) ? ColorScheme::Dark : ColorScheme::Light,
                                         settings.drawsHighContrast() ? Contrast::High : Contrast::Normal);
    host_.conversation()->setPalette(palette);
    return palette;
}

std::optional<host::Failure> RenderCommand::write(const std::string& output) const {
    const host::HostSettings& settings = host_.settings();
    const Palette& palette = choosePalette();
    const double height = host_.settle(settings.width);
    const bool splits = output.ends_with(".png") && height * settings.scale > kMostPixels;
    // Whole points keep the pieces' edges on pixels at every usual scale.
    const double most = splits ? std::floor(kMostPixels / settings.scale) : height;
    const int pieces = splits ? static_cast<int>(std::ceil(height / most)) : 1;
    documents::StagedFiles files;
    for (int number = 1; number <= pieces; ++number) {
        const double top = (number - 1) * most;
        const double partHeight = std::min(most, height - top);
        const ScenePainter painter({settings.width, partHeight}, settings.scale, palette);
        if (const auto reason = painter.refusal()) {
            return host::Failure{host::ExitCode::NotDrawn, output + ": " + *reason};
        }
        const std::string file = splits ? pieceName(output, number) : output;
        if (const auto error = painter.add(file, part(host_.window(), top, partHeight), files)) {
            return host::Failure{host::ExitCode::Failure, *error};
        }
    }
    const std::string problem = files.commit();
    return problem.empty() ? std::nullopt : std::optional(host::Failure{host::ExitCode::Failure, problem});
}

}  // namespace ktr::app
