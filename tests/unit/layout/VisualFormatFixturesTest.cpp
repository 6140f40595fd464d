// Formats and what comes of them, from text files beside this one; fixtures/README.txt says how they are written.
#include <algorithm>
#include <cmath>
#include <filesystem>
#include <fstream>
#include <sstream>

#include "platform/layout/VisualFormat.h"
#include "platform/ui/View.h"
#include "tests/support/PlatformTest.h"
#include "tests/unit/layout/PrintRect.h"

namespace ktr::test {

using namespace platform;

namespace {

/// What sums of doubles leave.
constexpr double kClose = 1e-9;

/// A view with a content of its own.
struct Content : View {
    IntrinsicSize intrinsicContentSize(double) const override { return size; }
    IntrinsicSize size;
};

struct Format {
    std::string text;
    VisualFormatOptions options;
};

struct Case {
    std::string name;
    Size size;
    std::vector<std::pair<std::string, IntrinsicSize>> views;
    VisualFormatMetrics metrics;
    std::vector<Format> formats;
    std::map<std::string, Rect> leftToRight;
    std::map<std::string, Rect> rightToLeft;
    std::string error;
};

std::vector<std::string> words(const std::string& line) {
    std::istringstream stream(line);
    std::vector<std::string> list;
    for (std::string word; stream >> word;) {
        list.push_back(word);
    }
    return list;
}

Format formatOf(const std::vector<std::string>& parts) {
    static const std::map<std::string, VisualFormatAlignment> kAlignments = {
        {"top", VisualFormatAlignment::Top},
        {"bottom", VisualFormatAlignment::Bottom},
        {"centerY", VisualFormatAlignment::CenterY},
        {"firstBaseline", VisualFormatAlignment::FirstBaseline},
        {"lastBaseline", VisualFormatAlignment::LastBaseline},
        {"leading", VisualFormatAlignment::Leading},
        {"trailing", VisualFormatAlignment::Trailing},
        {"left", VisualFormatAlignment::Left},
        {"right", VisualFormatAlignment::Right},
        {"centerX", VisualFormatAlignment::CenterX}};
    Format format{parts.at(1), {}};
    for (std::size_t i = 2; i < parts.size(); ++i) {
        if (parts[i] == "leftToRight") {
            format.options.direction = VisualFormatDirection::LeftToRight;
        } else if (parts[i] == "rightToLeft") {
            format.options.direction = VisualFormatDirection::RightToLeft;
        } else {
            format.options.alignment = format.options.alignment | kAlignments.at(parts[i]);
        }
    }
    return format;
}

std::optional<double> extent(const std::string& word) {
    return word == "-" ? std::nullopt : std::optional(std::stod(word));
}

Rect rectOf(const std::vector<std::string>& parts) {
    return {std::stod(parts.at(2)), std::stod(parts.at(3)), std::stod(parts.at(4)), std::stod(parts.at(5))};
}

std::vector<Case> casesIn(const std::filesystem::path& path) {
    std::ifstream file(path);
    std::vector<Case> cases;
    for (std::string line; std::getline(file, line);) {
        const auto parts = words(line);
        if (parts.empty() || parts[0][0] == '#') {
            continue;
        }
        if (parts[0] == "case") {
            cases.push_back({line.substr(5), {}, {}, {}, {}, {}, {}, {}});
            continue;
        }
        Case& current = cases.at(cases.size() - 1);
        if (parts[0] == "size") {
            current.size = {std::stod(parts.at(1)), std::stod(parts.at(2))};
        } else if (parts[0] == "view") {
            current.views.emplace_back(parts.at(1), IntrinsicSize{extent(parts.at(2)), extent(parts.at(3))});
        } else if (parts[0] == "metric") {
            current.metrics[parts.at(1)] = std::stod(parts.at(2));
        } else if (parts[0] == "format") {
            current.formats.push_back(formatOf(parts));
        } else if (parts[0] == "frame") {
            current.leftToRight[parts.at(1)] = rectOf(parts);
        } else if (parts[0] == "mirrored") {
            current.rightToLeft[parts.at(1)] = rectOf(parts);
        } else if (parts[0] == "error") {
            current.error = line.substr(6);
        } else {
            ADD_FAILURE() << path << ": what is '" << parts[0] << "'?";
        }
    }
    return cases;
}

std::vector<std::filesystem::path> fixtureFiles() {
    std::vector<std::filesystem::path> files;
    for (const auto& entry : std::filesystem::directory_iterator(KTR_TEST_DATA "/unit/layout/fixtures")) {
        if (entry.path().extension() == ".fixture") {
            files.push_back(entry.path());
        }
    }
    std::sort(files.begin(), files.end());
    return files;
}

}  // namespace

class VisualFormatFixturesTest : public PlatformTest, public testing::WithParamInterface<std::filesystem::path> {
  protected:
    static void expectError(const Case& of) {
        const auto superview = create<View>(&View::initWithFrame, Rect{});
        VisualFormatViews views;
        for (const auto& [name, size] : of.views) {
            views[name] = create<Content>(&View::initWithFrame, Rect{});
            superview->addSubview(views[name]);
        }
        const Format& format = of.formats.at(0);
        const auto result = VisualFormat::parse(format.text, format.options, of.metrics, views);
        EXPECT_TRUE(result.constraints.empty());
        EXPECT_EQ(result.error ? result.error->message() : "none", of.error);
    }

    void expectFrames(const Case& of, const std::map<std::string, Rect>& frames, bool rightToLeft) {
        if (frames.empty()) {
            return;
        }
        assistant->rightToLeft = rightToLeft;
        const auto superview = create<View>(&View::initWithFrame, Rect{0, 0, of.size.width, of.size.height});
        VisualFormatViews views;
        for (const auto& [name, size] : of.views) {
            const auto view = create<Content>(&View::initWithFrame, Rect{});
            view->size = size;
            view->setTranslatesAutoresizingMaskIntoConstraints(false);
            superview->addSubview(view);
            views[name] = view;
        }
        for (const Format& format : of.formats) {
            const auto result = VisualFormat::parse(format.text, format.options, of.metrics, views);
            EXPECT_FALSE(result.error) << format.text << ": " << result.error->message();
            superview->addConstraints(result.constraints);
        }
        superview->layoutIfNeeded();
        for (const auto& [name, frame] : frames) {
            ASSERT_TRUE(views.contains(name)) << name;
            const Rect& is = views[name]->frame();
            const bool isThere = std::abs(is.x - frame.x) < kClose && std::abs(is.y - frame.y) < kClose &&
                                 std::abs(is.width - frame.width) < kClose &&
                                 std::abs(is.height - frame.height) < kClose;
            EXPECT_TRUE(isThere) << name << (rightToLeft ? ", mirrored, is at " : " is at ")
                                 << testing::PrintToString(is);
        }
    }
};

TEST_P(VisualFormatFixturesTest, SaysWhatTheFileSays) {
    const auto cases = casesIn(GetParam());
    ASSERT_FALSE(cases.empty());
    for (const Case& one : cases) {
        SCOPED_TRACE(one.name);
        ASSERT_TRUE(!one.error.empty() || !one.leftToRight.empty() || !one.rightToLeft.empty()) << "expects nothing";
        if (!one.error.empty()) {
            expectError(one);
        }
        expectFrames(one, one.leftToRight, false);
        expectFrames(one, one.rightToLeft, true);
    }
}

INSTANTIATE_TEST_SUITE_P(Files, VisualFormatFixturesTest, testing::ValuesIn(fixtureFiles()),
                         [](const auto& file) { return file.param.stem().string(); });

}  // namespace ktr::test
