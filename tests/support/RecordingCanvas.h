#pragma once

#include <string>
#include <vector>

#include "platform/ui/Canvas.h"

namespace ktr::test {

/// Keeps what was painted, in the coordinates of the root.
class RecordingCanvas : public platform::Canvas {
  public:
    struct Call {
        enum class Kind { Fill, Text, Image, Path, Stroke, Halo } kind;
        platform::Rect rect;
        platform::Color color;
        const void* object = nullptr;
        /// Of outlines, in the coordinates of the root.
        platform::Path path;
    };

    void save() override { origins_.push_back(origin_); }
    void restore() override {
        origin_ = origins_.back();
        origins_.pop_back();
    }
    void translate(double dx, double dy) override {
        origin_.x += dx;
        origin_.y += dy;
    }
    void clip(const platform::Rect&) override {}
    void fill(const platform::Rect& rect, const platform::Color& color) override {
        if (!color.isClear()) {
            calls.push_back({Call::Kind::Fill, rect.offsetBy(origin_.x, origin_.y), color, nullptr, {}});
        }
    }
    void draw(const platform::TextLayout& text, platform::Point at, const platform::Color& color) override {
        calls.push_back({Call::Kind::Text,
                         {origin_.x + at.x, origin_.y + at.y, text.usedSize().width, text.usedSize().height},
                         color,
                         &text,
                         {}});
    }
    void draw(const platform::Image& image, const platform::Rect& rect) override {
        calls.push_back({Call::Kind::Image, rect.offsetBy(origin_.x, origin_.y), {}, &image, {}});
    }

    void drawMoving(const platform::Image& image, const platform::Rect& rect) override { draw(image, rect); }
    void fill(const platform::Path& path, const platform::Color& color) override {
        addPath(Call::Kind::Path, path, color);
    }
    void stroke(const platform::Path& path, const platform::Color& color, const platform::Stroke&) override {
        addPath(Call::Kind::Stroke, path, color);
    }
    void clip(const platform::Path&) override {}
    void drawHalo(const platform::TextLayout& text, platform::Point at, const platform::Color& color, double) override {
        draw(text, at, color);
        calls.back().kind = Call::Kind::Halo;
    }

    std::vector<Call> calls;

  private:
    void addPath(Call::Kind kind, const platform::Path& path, const platform::Color& color) {
        if (!color.isClear()) {
            const platform::Path placed = path.translated(origin_.x, origin_.y);
            calls.push_back({kind, placed.controlBounds(), color, nullptr, placed});
        }
    }

    platform::Point origin_;
    std::vector<platform::Point> origins_;
};

}  // namespace ktr::test
