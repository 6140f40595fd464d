#pragma once

#include <string>
#include <vector>

#include "platform/ui/Canvas.h"

namespace ktr::test {

/// Keeps what was painted, in the coordinates of the root.
class RecordingCanvas : public platform::Canvas {
  public:
    struct Call {
        enum class Kind { Fill, Text, Image } kind;
        platform::Rect rect;
        platform::Color color;
        const void* object = nullptr;
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
            calls.push_back({Call::Kind::Fill, rect.offsetBy(origin_.x, origin_.y), color, nullptr});
        }
    }
    void draw(const platform::TextLayout& text, platform::Point at, const platform::Color& color) override {
        calls.push_back({Call::Kind::Text,
                         {origin_.x + at.x, origin_.y + at.y, text.usedSize().width, text.usedSize().height},
                         color,
                         &text});
    }
    void draw(const platform::Image& image, const platform::Rect& rect) override {
        calls.push_back({Call::Kind::Image, rect.offsetBy(origin_.x, origin_.y), {}, &image});
    }

    std::vector<Call> calls;

  private:
    platform::Point origin_;
    std::vector<platform::Point> origins_;
};

}  // namespace ktr::test
