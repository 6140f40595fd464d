#include "platform/layout/VisualFormat.h"

#include <limits>

#include "platform/ui/View.h"
#include "tests/support/PlatformTest.h"

namespace ktr::test {

using namespace platform;

class VisualFormatTest : public PlatformTest {
  protected:
    VisualFormatTest() {
        for (const char* name : {"a", "b", "c"}) {
            const auto view = create<View>(&View::initWithFrame, Rect{});
            superview->addSubview(view);
            views[name] = view;
        }
        views["alone"] = create<View>(&View::initWithFrame, Rect{});
        views["gone"] = nullptr;
        names_[superview.get()] = "|";
        for (const auto& [name, view] : views) {
            names_[view.get()] = name;
        }
    }
    /// Each constraint as "b.left = a.right + 8 @500"; or the error.
    std::vector<std::string> parse(std::string_view format, VisualFormatOptions options = {}) {
        const VisualFormatResult result = VisualFormat::parse(format, options, metrics, views);
        if (result.error) {
            EXPECT_TRUE(result.constraints.empty());
            return {result.error->message()};
        }
        std::vector<std::string> texts;
        for (const auto& constraint : result.constraints) {
            texts.push_back(text(*constraint));
        }
        return texts;
    }
    std::string text(const LayoutConstraint& constraint) {
        std::string text = constraint.description();
        const auto put = [&text](const std::string& place, const std::string& name) {
            const auto at = text.find(place);
            if (at != std::string::npos) {
                text.replace(at, place.size(), name);
            }
        };
        put("first", names_[constraint.first().view().get()]);
        put("second", names_[constraint.second().view().get()]);
        put(" @1000", "");
        return text;
    }
    using Texts = std::vector<std::string>;

    std::shared_ptr<View> superview = create<View>(&View::initWithFrame, Rect{});
    VisualFormatMetrics metrics = {{"m", 12},   {"low", 250.5},
                                   {"zero", 0}, {"none", std::numeric_limits<double>::quiet_NaN()},
                                   {"b2", 4},   {"größe", 7}};
    VisualFormatViews views;

  private:
    std::map<const View*, std::string> names_;
};

// --- what it says
// -----------------------------------------------------------------------------------------------------

TEST_F(VisualFormatTest, OneView_SaysNothing) {
    EXPECT_EQ(parse("[a]"), Texts{});
    EXPECT_EQ(parse("V:[a]"), Texts{});
}

TEST_F(VisualFormatTest, Horizontal_IsTheDefault) {
    EXPECT_EQ(parse("[a]-5-[b]"), Texts{"b.leading = a.trailing + 5"});
    EXPECT_EQ(parse("H:[a]-5-[b]"), Texts{"b.leading = a.trailing + 5"});
}

TEST_F(VisualFormatTest, Vertical_GoesFromTopToBottom) {
    EXPECT_EQ(parse("V:|-1-[a(5)]-2-[b]-3-|"),
              (Texts{"a.top = |.top + 1", "a.height = 5", "b.top = a.bottom + 2", "|.bottom = b.bottom + 3"}));
}

TEST_F(VisualFormatTest, Superview_AtEitherEnd) {
    EXPECT_EQ(parse("|-1-[a]"), Texts{"a.leading = |.leading + 1"});
    EXPECT_EQ(parse("[a]-1-|"), Texts{"|.trailing = a.trailing + 1"});
    EXPECT_EQ(parse("|[a]|"), (Texts{"a.leading = |.leading + 0", "|.trailing = a.trailing + 0"}));
}

TEST_F(VisualFormatTest, NoConnection_Touches) {
    EXPECT_EQ(parse("[a][b]"), Texts{"b.leading = a.trailing + 0"});
}

TEST_F(VisualFormatTest, BareConnection_IsTheStandardSpace) {
    EXPECT_EQ(parse("|-[a]-[b]-|"),
              (Texts{"a.leading = |.leading + 20", "b.leading = a.trailing + 8", "|.trailing = b.trailing + 20"}));
    EXPECT_EQ(parse("V:|-[a]-[b]"), (Texts{"a.top = |.top + 20", "b.top = a.bottom + 8"}));
}

TEST_F(VisualFormatTest, Connection_NumberOrMetric) {
    EXPECT_EQ(parse("[a]-0.5-[b]"), Texts{"b.leading = a.trailing + 0.5"});
    EXPECT_EQ(parse("[a]-.5-[b]"), Texts{"b.leading = a.trailing + 0.5"});
    EXPECT_EQ(parse("[a]-(-.5)-[b]"), Texts{"b.leading = a.trailing - 0.5"});
    EXPECT_EQ(parse("[a]-m-[b]"), Texts{"b.leading = a.trailing + 12"});
    EXPECT_EQ(parse("[a]-b2-[b]"), Texts{"b.leading = a.trailing + 4"});
    EXPECT_EQ(parse("[a]-größe-[b]"), Texts{"b.leading = a.trailing + 7"});
    EXPECT_EQ(parse("[a]-(m)-[b]"), Texts{"b.leading = a.trailing + 12"});
    EXPECT_EQ(parse("[a]-(-3)-[b]"), Texts{"b.leading = a.trailing - 3"});
}

TEST_F(VisualFormatTest, Connection_Relations) {
    EXPECT_EQ(parse("[a]-(==3)-[b]"), Texts{"b.leading = a.trailing + 3"});
    EXPECT_EQ(parse("[a]-(>=m)-[b]"), Texts{"b.leading >= a.trailing + 12"});
    EXPECT_EQ(parse("[a]-(<=3)-|"), Texts{"|.trailing <= a.trailing + 3"});
}

TEST_F(VisualFormatTest, Connection_ListOfPredicates) {
    EXPECT_EQ(parse("[a]-(>=3,<=m@700,5@low)-[b]"),
              (Texts{"b.leading >= a.trailing + 3", "b.leading <= a.trailing + 12 @700",
                     "b.leading = a.trailing + 5 @250.5"}));
}

TEST_F(VisualFormatTest, Size_NumberMetricOrView) {
    EXPECT_EQ(parse("[a(54)]"), Texts{"a.width = 54"});
    EXPECT_EQ(parse("[a(m)]"), Texts{"a.width = 12"});
    EXPECT_EQ(parse("[a(==b)]"), Texts{"a.width = b.width + 0"});
    EXPECT_EQ(parse("[a(b)]"), Texts{"a.width = b.width + 0"});
    EXPECT_EQ(parse("V:[a(>=b@600)]"), Texts{"a.height >= b.height + 0 @600"});
    EXPECT_EQ(parse("[a(<=b,>=5@low,==m@1)]"),
              (Texts{"a.width <= b.width + 0", "a.width >= 5 @250.5", "a.width = 12 @1"}));
}

TEST_F(VisualFormatTest, Size_MetricGoesBeforeAViewOfTheSameName) {
    metrics["b"] = 33.0;
    EXPECT_EQ(parse("[a(b)]"), Texts{"a.width = 33"});
}

TEST_F(VisualFormatTest, Priority_ReachesFromOneToThousand) {
    EXPECT_EQ(parse("[a(1@1)]"), Texts{"a.width = 1 @1"});
    EXPECT_EQ(parse("[a(1@999.5)]"), Texts{"a.width = 1 @999.5"});
    EXPECT_EQ(parse("[a(1@1000)]"), Texts{"a.width = 1"});
}

TEST_F(VisualFormatTest, ManyViews_InOrder) {
    EXPECT_EQ(parse("H:|-m-[a(1)]-[b(2)][c(3)]-(>=m)-|"),
              (Texts{"a.leading = |.leading + 12", "a.width = 1", "b.leading = a.trailing + 8", "b.width = 2",
                     "c.leading = b.trailing + 0", "c.width = 3", "|.trailing >= c.trailing + 12"}));
}

TEST_F(VisualFormatTest, LeftToRight_DoesNotFollowTheDirection) {
    EXPECT_EQ(parse("|-1-[a]-(>=2)-[b]-3-|", {{}, VisualFormatDirection::LeftToRight}),
              (Texts{"a.left = |.left + 1", "b.left >= a.right + 2", "|.right = b.right + 3"}));
}

TEST_F(VisualFormatTest, RightToLeft_BeginsAtTheRight) {
    EXPECT_EQ(parse("|-1-[a]-(>=2)-[b]-3-|", {{}, VisualFormatDirection::RightToLeft}),
              (Texts{"|.right = a.right + 1", "a.left >= b.right + 2", "b.left = |.left + 3"}));
}

TEST_F(VisualFormatTest, Direction_LeavesVerticalFormatsAlone) {
    EXPECT_EQ(parse("V:|-1-[a]", {{}, VisualFormatDirection::RightToLeft}), Texts{"a.top = |.top + 1"});
}

TEST_F(VisualFormatTest, Alignment_OfHorizontalFormats) {
    const std::pair<VisualFormatAlignment, const char*> cases[] = {
        {VisualFormatAlignment::Top, "top"},
        {VisualFormatAlignment::Bottom, "bottom"},
        {VisualFormatAlignment::CenterY, "centerY"},
        {VisualFormatAlignment::FirstBaseline, "firstBaseline"},
        {VisualFormatAlignment::LastBaseline, "lastBaseline"},
    };
    for (const auto& [alignment, name] : cases) {
        const std::string edge = name;
        EXPECT_EQ(parse("|[a][b][c]", {alignment, {}}),
                  (Texts{"a.leading = |.leading + 0", "b.leading = a.trailing + 0", "c.leading = b.trailing + 0",
                         "b." + edge + " = a." + edge + " + 0", "c." + edge + " = b." + edge + " + 0"}));
    }
}

TEST_F(VisualFormatTest, Alignment_OfVerticalFormats) {
    const std::pair<VisualFormatAlignment, const char*> cases[] = {
        {VisualFormatAlignment::Leading, "leading"}, {VisualFormatAlignment::Trailing, "trailing"},
        {VisualFormatAlignment::Left, "left"},       {VisualFormatAlignment::Right, "right"},
        {VisualFormatAlignment::CenterX, "centerX"},
    };
    for (const auto& [alignment, name] : cases) {
        const std::string edge = name;
        EXPECT_EQ(parse("V:[a][b]", {alignment, {}}),
                  (Texts{"b.top = a.bottom + 0", "b." + edge + " = a." + edge + " + 0"}));
    }
}

TEST_F(VisualFormatTest, Alignments_Combine) {
    EXPECT_EQ(parse("[a][b]", {VisualFormatAlignment::Bottom | VisualFormatAlignment::Top, {}}),
              (Texts{"b.leading = a.trailing + 0", "b.top = a.top + 0", "b.bottom = a.bottom + 0"}));
}

// --- errors
// -----------------------------------------------------------------------------------------------------------

struct FormatError {
    const char* format;
    const char* message;
};

class VisualFormatErrorTest : public VisualFormatTest, public ::testing::WithParamInterface<FormatError> {};

TEST_P(VisualFormatErrorTest, NamesItsPlace) {
    EXPECT_EQ(parse(GetParam().format), Texts{GetParam().message});
}

INSTANTIATE_TEST_SUITE_P(
    All, VisualFormatErrorTest,
    ::testing::Values(
        FormatError{"", "column 1: expected 'H:', 'V:', '|' or '['"},
        FormatError{"Z:[a]", "column 1: expected 'H:', 'V:', '|' or '['"},
        FormatError{" [a]", "column 1: expected 'H:', 'V:', '|' or '['"}, FormatError{"H", "column 2: expected ':'"},
        FormatError{"V[a]", "column 2: expected ':'"}, FormatError{"H:", "column 3: expected '['"},
        FormatError{"|", "column 2: expected '['"}, FormatError{"||", "column 2: expected '['"},
        FormatError{"|-|", "column 3: expected '['"}, FormatError{"|-8", "column 4: expected '-'"},
        FormatError{"|-8[a]", "column 4: expected '-'"}, FormatError{"|-8-", "column 5: expected '['"},
        FormatError{"|-", "column 3: expected a number, a metric, '(', '[' or '|'"},
        FormatError{"|--[a]", "column 3: expected a number, a metric, '(', '[' or '|'"},
        FormatError{"[a]-", "column 5: expected a number, a metric, '(', '[' or '|'"},
        FormatError{"[a]--3-[b]", "column 5: expected a number, a metric, '(', '[' or '|'"},
        FormatError{"[a]->=3-[b]", "column 5: expected a number, a metric, '(', '[' or '|'"},
        FormatError{"[a]-8-", "column 7: expected '[' or '|'"}, FormatError{"[a]-8-b", "column 7: expected '[' or '|'"},
        FormatError{"[a]-8e5-[b]", "column 6: expected '-'"},
        FormatError{"[a]8[b]", "column 4: expected '-', '[', '|' or the end"},
        FormatError{"[a] [b]", "column 4: expected '-', '[', '|' or the end"},
        FormatError{"[a]-|[b]", "column 6: expected the end"}, FormatError{"[a]| ", "column 5: expected the end"},
        FormatError{"[", "column 2: expected a view's name"}, FormatError{"[]", "column 2: expected a view's name"},
        FormatError{"[8]", "column 2: expected a view's name"}, FormatError{"[a", "column 3: expected '(' or ']'"},
        FormatError{"[a b]", "column 3: expected '(' or ']'"}, FormatError{"[a(8)", "column 6: expected ']'"},
        FormatError{"[a(8)(9)]", "column 6: expected ']'"},
        FormatError{"[a()]", "column 4: expected a number, a metric or a view's name"},
        FormatError{"[a(>=)]", "column 6: expected a number, a metric or a view's name"},
        FormatError{"[a(8,)]", "column 6: expected a number, a metric or a view's name"},
        FormatError{"[a(=8)]", "column 4: expected '==', '<=' or '>='"},
        FormatError{"[a(>8)]", "column 4: expected '==', '<=' or '>='"},
        FormatError{"[a(<8)]", "column 4: expected '==', '<=' or '>='"},
        FormatError{"[a(8", "column 5: expected '@', ',' or ')'"},
        FormatError{"[a(8]", "column 5: expected '@', ',' or ')'"},
        FormatError{"[a(8@5]", "column 7: expected ',' or ')'"},
        FormatError{"[a(8@)]", "column 6: expected a priority: a number or a metric"},
        FormatError{"[a(8@-1)]", "column 6: expected a priority: a number or a metric"},
        FormatError{"[a(8@0)]", "column 6: expected a priority from 1 to 1000"},
        FormatError{"H:[a]-5.-[b]", "column 8: expected '-'"},
        FormatError{"[a(.)]", "column 4: expected a number, a metric or a view's name"},
        FormatError{"[a(8@1000.5)]", "column 6: expected a priority from 1 to 1000"},
        FormatError{"[a(8@zero)]", "column 6: expected a priority from 1 to 1000"},
        FormatError{"[a(8@b)]", "column 6: no metric is named 'b'"},
        FormatError{"[a(-)]", "column 5: expected a digit"},
        FormatError{"[a]-()-[b]", "column 6: expected a number or a metric"},
        FormatError{"[a]-(8,>=)-[b]", "column 10: expected a number or a metric"},
        FormatError{"[a]-(8)[b]", "column 8: expected '-'"},
        FormatError{"[a]-(b)-[c]", "column 6: no metric is named 'b'"},
        FormatError{"[a]-x-[b]", "column 5: no metric is named 'x'"},
        FormatError{"[a]-none-[b]", "column 5: the metric 'none' is not a finite number"},
        FormatError{"[a(none)]", "column 4: the metric 'none' is not a finite number"},
        FormatError{"[a(x)]", "column 4: no metric or view is named 'x'"},
        FormatError{"[a]-[x]", "column 6: no view is named 'x'"},
        FormatError{"[gone]", "column 2: no view is named 'gone'"},
        FormatError{"|-[alone]", "column 1: the view 'alone' has no superview"},
        FormatError{"[a][alone]-|", "column 12: the view 'alone' has no superview"},
        FormatError{"[a]-größe-[ü]", "column 12: no view is named 'ü'"}));

TEST_F(VisualFormatTest, Error_CountsBytesAndCharacters) {
    const auto result = VisualFormat::parse("[a]-größe-[ü]", {}, metrics, views);
    ASSERT_TRUE(result.error.has_value());
    EXPECT_EQ(result.error->column, 12U);
    EXPECT_EQ(result.error->offset, 13U);
    EXPECT_EQ(result.error->expected, "no view is named 'ü'");
}

TEST_F(VisualFormatTest, Error_NumberOutOfRange) {
    const std::string huge = "[a(" + std::string(400, '9') + ")]";
    EXPECT_EQ(parse(huge), Texts{"column 4: expected a number within range"});
}

TEST_F(VisualFormatTest, Error_AlignmentAcrossTheFormat) {
    EXPECT_EQ(parse("[a][b]", {VisualFormatAlignment::Leading, {}}),
              Texts{"column 1: a horizontal format cannot align its views horizontally"});
    EXPECT_EQ(parse("V:[a][b]", {VisualFormatAlignment::LastBaseline, {}}),
              Texts{"column 1: a vertical format cannot align its views vertically"});
}

TEST_F(VisualFormatTest, Error_InAProgram_IsLoggedAndGivesNone) {
    expectErrorLine("The visual format [a is wrong at column 3: expected '(' or ']'");
    EXPECT_TRUE(VisualFormat::constraintsWithVisualFormat("[a", {}, metrics, views).empty());
    EXPECT_TRUE(log->has(LogLevel::Error, "The visual format [a is wrong at column 3: expected '(' or ']'"));
    EXPECT_EQ(VisualFormat::constraintsWithVisualFormat("[a(8)]", {}, metrics, views).size(), 1U);
}

TEST_F(VisualFormatTest, EveryPrefixOfAFormat_IsAnErrorOrAFormat) {
    const std::string whole = "H:|-m-[a(>=5@low,==b)]-(>=3,<=m@700)-[b]-[c(54)]-|";
    for (std::size_t length = 0; length < whole.size(); ++length) {
        const auto result = VisualFormat::parse(whole.substr(0, length), {}, metrics, views);
        if (result.error) {
            EXPECT_EQ(result.error->offset, std::min(result.error->offset, length));
        }
    }
    EXPECT_EQ(parse(whole).size(), 8U);
}

}  // namespace ktr::test
