// A row with four texts, an icon and a hairline, the way rows of an answer are built: exact rectangles.
#include "platform/layout/LayoutConstraint.h"
#include "platform/layout/LayoutScope.h"
#include "platform/layout/VisualFormat.h"
#include "platform/ui/Label.h"
#include "platform/ui/StackView.h"
#include "tests/support/PlatformTest.h"
#include "tests/unit/layout/PrintRect.h"

namespace ktr::test {

using namespace platform;

namespace {

constexpr double kSmall = 13.0;  // em of place and age: their lines are 18 high, the baseline at 14
constexpr double kLarge = 16.0;  // em of name and distance: 22 and 17

std::string glyphs(int count) {
    return std::string(static_cast<std::size_t>(count), 'x');
}

}  // namespace

class RowLayoutTest : public PlatformTest {
  protected:
    void buildRow(double width, double height) {
        row = create<View>(&View::initWithFrame, Rect{0.0, 0.0, width, height});
        icon = create<View>(&View::initWithFrame, Rect{0.0, 0.0, 54.0, 54.0});
        avatar = create<View>(&View::initWithFrame, Rect{});
        separator = create<View>(&View::initWithFrame, Rect{});
        avatar->setTranslatesAutoresizingMaskIntoConstraints(false);
        icon->addSubview(avatar);
        for (const auto attribute :
             {LayoutAttribute::Top, LayoutAttribute::Bottom, LayoutAttribute::Leading, LayoutAttribute::Trailing}) {
            avatar->anchor(attribute).constraintEqualTo(icon->anchor(attribute))->setActive(true);
        }
        name = label(kLarge, 250.0, 250.0);
        age = label(kSmall, 1000.0, 250.0);
        place = label(kSmall, 1000.0, 250.0);
        distance = label(kLarge, 1000.0, 1000.0);
        for (const auto& view : {icon, separator}) {
            view->setTranslatesAutoresizingMaskIntoConstraints(false);
            row->addSubview(view);
        }
        const VisualFormatMetrics metrics = {{"margin", 15}, {"vmargin", 10}, {"hs", 13}, {"vs", 0},
                                             {"pd", 54},     {"ld", 16},      {"lm", 82}, {"st", 0.5}};
        const VisualFormatViews views = {{"name", name},         {"place", place}, {"age", age},
                                         {"distance", distance}, {"icon", icon},   {"separator", separator}};
        const auto add = [&](const char* format, VisualFormatOptions options = {}) {
            row->addConstraints(VisualFormat::constraintsWithVisualFormat(format, options, metrics, views));
        };
        add("H:|-margin-[icon(pd)]");
        add("H:|-lm-[place]-margin-|");
        add("H:|-lm-[name]-hs-[distance]-margin-|", {VisualFormatAlignment::LastBaseline});
        add("H:|-lm-[age]-margin-|");
        add("H:|-0-[separator]-0-|");
        add("V:|-vmargin-[icon(pd)]-(>=vmargin)-|");
        add("V:|-vmargin-[place]-vs-[name]-vs-[age]-(>=vmargin)-[separator(st)]-0-|");
    }
    std::shared_ptr<Label> label(double size, double horizontalResistance, double horizontalHugging) {
        const auto made = create<Label>(&Label::initWithFrame, Rect{});
        made->setFont({FontFace::Text, FontWeight::Regular, size});
        made->setTranslatesAutoresizingMaskIntoConstraints(false);
        made->setContentCompressionResistancePriority(1000.0, LayoutAxis::Vertical);
        made->setContentCompressionResistancePriority(horizontalResistance, LayoutAxis::Horizontal);
        made->setContentHuggingPriority(1000.0, LayoutAxis::Vertical);
        made->setContentHuggingPriority(horizontalHugging, LayoutAxis::Horizontal);
        row->addSubview(made);
        return made;
    }
    void setTexts(int placeGlyphs, int nameGlyphs, int distanceGlyphs, int ageGlyphs) {
        place->setText(glyphs(placeGlyphs));
        name->setText(glyphs(nameGlyphs));
        distance->setText(glyphs(distanceGlyphs));
        age->setText(glyphs(ageGlyphs));
    }
    double height() { return row->systemLayoutSizeFitting({row->frame().width, 0.0}, 750.0, 750.0).height; }
    std::vector<std::string> debugLines() const { return log->texts(LogLevel::Debug); }

    std::shared_ptr<View> row;
    std::shared_ptr<View> icon;
    std::shared_ptr<View> avatar;
    std::shared_ptr<View> separator;
    std::shared_ptr<Label> name;
    std::shared_ptr<Label> place;
    std::shared_ptr<Label> age;
    std::shared_ptr<Label> distance;
};

TEST_F(RowLayoutTest, LeftToRight) {
    buildRow(400.0, 78.5);
    setTexts(6, 4, 5, 7);
    row->layoutIfNeeded();
    EXPECT_EQ(icon->frame(), (Rect{15, 10, 54, 54}));
    EXPECT_EQ(avatar->frame(), (Rect{0, 0, 54, 54}));
    EXPECT_EQ(place->frame(), (Rect{82, 10, 303, 18}));
    EXPECT_EQ(name->frame(), (Rect{82, 28, 210, 22}));
    EXPECT_EQ(distance->frame(), (Rect{305, 28, 80, 22}));
    EXPECT_EQ(age->frame(), (Rect{82, 50, 303, 18}));
    EXPECT_EQ(separator->frame(), (Rect{0, 78, 400, 0.5}));
    EXPECT_TRUE(debugLines().empty());
}

TEST_F(RowLayoutTest, RightToLeft_IsMirrored) {
    assistant->rightToLeft = true;
    buildRow(400.0, 78.5);
    setTexts(6, 4, 5, 7);
    row->layoutIfNeeded();
    EXPECT_EQ(icon->frame(), (Rect{331, 10, 54, 54}));
    EXPECT_EQ(avatar->frame(), (Rect{0, 0, 54, 54}));
    EXPECT_EQ(place->frame(), (Rect{15, 10, 303, 18}));
    EXPECT_EQ(name->frame(), (Rect{108, 28, 210, 22}));
    EXPECT_EQ(distance->frame(), (Rect{15, 28, 80, 22}));
    EXPECT_EQ(age->frame(), (Rect{15, 50, 303, 18}));
    EXPECT_EQ(separator->frame(), (Rect{0, 78, 400, 0.5}));
}

TEST_F(RowLayoutTest, DirectionThatChanges_IsFollowedAtTheNextLayout) {
    buildRow(400.0, 78.5);
    row->layoutIfNeeded();
    EXPECT_EQ(icon->frame().x, 15.0);
    assistant->rightToLeft = true;
    row->setNeedsLayout();
    row->layoutIfNeeded();
    EXPECT_EQ(icon->frame().x, 331.0);
}

TEST_F(RowLayoutTest, FittingHeight_IsTheTextsAndTheirMargins) {
    buildRow(400.0, 0.0);
    setTexts(6, 4, 5, 7);
    EXPECT_EQ(height(), 78.5);
}

TEST_F(RowLayoutTest, FittingHeight_IsThatOfEmptyTextsToo) {
    buildRow(400.0, 0.0);
    EXPECT_EQ(height(), 78.5);
}

TEST_F(RowLayoutTest, FittingHeight_IconIsTheLeast) {
    buildRow(400.0, 0.0);
    for (const auto& text : {place, name, age}) {
        text->setFont({FontFace::Text, FontWeight::Regular, 10.0});  // lines of 14
    }
    EXPECT_EQ(height(), 74.0);
}

TEST_F(RowLayoutTest, FittingHeight_DoesNotGrowWithLongTexts) {
    buildRow(320.0, 0.0);
    setTexts(400, 400, 30, 400);
    EXPECT_EQ(height(), 78.5);
    EXPECT_TRUE(debugLines().empty());
}

TEST_F(RowLayoutTest, LongName_GivesWayToTheDistance) {
    buildRow(400.0, 78.5);
    setTexts(6, 60, 5, 7);
    row->layoutIfNeeded();
    EXPECT_EQ(name->frame(), (Rect{82, 28, 210, 22}));
    EXPECT_EQ(distance->frame(), (Rect{305, 28, 80, 22}));
    EXPECT_TRUE(name->textLayout()->isTruncated());
    EXPECT_FALSE(distance->textLayout()->isTruncated());
}

TEST_F(RowLayoutTest, LongPlace_TruncatesThoughItResistsAtThousand) {
    buildRow(400.0, 78.5);
    setTexts(60, 4, 5, 60);
    row->layoutIfNeeded();
    EXPECT_EQ(place->frame(), (Rect{82, 10, 303, 18}));
    EXPECT_EQ(age->frame(), (Rect{82, 50, 303, 18}));
    EXPECT_TRUE(place->textLayout()->isTruncated());
    EXPECT_EQ(row->frame(), (Rect{0, 0, 400, 78.5}));
    EXPECT_TRUE(debugLines().empty());
}

TEST_F(RowLayoutTest, DistanceWiderThanTheRoom_LeavesTheNameNoneAndIsCut) {
    buildRow(200.0, 78.5);
    setTexts(6, 4, 10, 7);
    row->layoutIfNeeded();
    EXPECT_EQ(name->frame(), (Rect{82, 28, 0, 22}));
    EXPECT_EQ(distance->frame(), (Rect{95, 28, 90, 22}));
}

TEST_F(RowLayoutTest, EmptyDistance_LeavesTheNameItsRoom) {
    buildRow(400.0, 78.5);
    setTexts(6, 4, 0, 7);
    row->layoutIfNeeded();
    EXPECT_EQ(name->frame(), (Rect{82, 28, 290, 22}));
    EXPECT_EQ(distance->frame(), (Rect{385, 28, 0, 22}));
}

TEST_F(RowLayoutTest, DifferentFonts_ShareTheirLastBaseline) {
    buildRow(400.0, 82.5);
    setTexts(6, 4, 5, 7);
    name->setFont({FontFace::Text, FontWeight::Bold, 20.0});  // 28 high, the baseline at 21
    row->layoutIfNeeded();
    EXPECT_EQ(name->frame(), (Rect{82, 28, 210, 28}));
    EXPECT_EQ(distance->frame(), (Rect{305, 32, 80, 22}));
    EXPECT_EQ(height(), 84.5);
}

TEST_F(RowLayoutTest, HigherThanItFits_KeepsTextsAtTheTopAndTheLineAtTheBottom) {
    buildRow(400.0, 120.0);
    setTexts(6, 4, 5, 7);
    row->layoutIfNeeded();
    EXPECT_EQ(place->frame(), (Rect{82, 10, 303, 18}));
    EXPECT_EQ(age->frame(), (Rect{82, 50, 303, 18}));
    EXPECT_EQ(separator->frame(), (Rect{0, 119.5, 400, 0.5}));
}

TEST_F(RowLayoutTest, LowerThanItFits_SqueezesTheLastTextFirst) {
    buildRow(400.0, 74.0);
    setTexts(6, 4, 5, 7);
    row->layoutIfNeeded();
    // In the order in which the constraints met them: place, name, distance, age.
    EXPECT_EQ(place->frame(), (Rect{82, 10, 303, 18}));
    EXPECT_EQ(name->frame(), (Rect{82, 28, 210, 22}));
    EXPECT_EQ(age->frame(), (Rect{82, 50, 303, 13.5}));
    EXPECT_EQ(separator->frame(), (Rect{0, 73.5, 400, 0.5}));
    EXPECT_TRUE(debugLines().empty());
}

TEST_F(RowLayoutTest, NoHeight_DropsTheNewestWithDebugLinesAndComesBack) {
    buildRow(400.0, 0.0);
    setTexts(6, 4, 5, 7);
    row->layoutIfNeeded();
    EXPECT_THAT(debugLines(), ::testing::Contains("A required constraint conflicts with earlier ones and is dropped: "
                                                  "owner.height - view1.height - view1.y >= 10"));
    EXPECT_EQ(place->frame().y, 10.0);
    row->setFrame({0, 0, 400, 78.5});
    row->layoutIfNeeded();
    EXPECT_EQ(age->frame(), (Rect{82, 50, 303, 18}));
    EXPECT_EQ(separator->frame(), (Rect{0, 78, 400, 0.5}));
}

TEST_F(RowLayoutTest, NarrowerThanItsMargins_HasNoNegativeWidth) {
    buildRow(60.0, 78.5);
    setTexts(6, 4, 5, 7);
    row->layoutIfNeeded();
    for (const auto& text : {place, name, age, distance}) {
        EXPECT_EQ(text->frame().width, 0.0);
    }
    EXPECT_EQ(icon->frame(), (Rect{15, 10, 54, 54}));
}

TEST_F(RowLayoutTest, HiddenView_KeepsItsPlace) {
    buildRow(400.0, 78.5);
    setTexts(6, 4, 5, 7);
    separator->setHidden(true);
    distance->setHidden(true);
    row->layoutIfNeeded();
    EXPECT_EQ(separator->frame(), (Rect{0, 78, 400, 0.5}));
    EXPECT_EQ(distance->frame(), (Rect{305, 28, 80, 22}));
    EXPECT_EQ(height(), 78.5);
}

TEST_F(RowLayoutTest, TextThatChanges_IsLaidOutAgain) {
    buildRow(400.0, 78.5);
    setTexts(6, 4, 5, 7);
    row->layoutIfNeeded();
    distance->setText(glyphs(3));
    row->layoutIfNeeded();
    EXPECT_EQ(distance->frame(), (Rect{337, 28, 48, 22}));
    EXPECT_EQ(name->frame(), (Rect{82, 28, 242, 22}));
}

TEST_F(RowLayoutTest, WidthThatChanges_IsFollowed) {
    buildRow(400.0, 78.5);
    setTexts(6, 4, 5, 7);
    row->layoutIfNeeded();
    row->setFrame({0, 0, 360, 78.5});
    row->layoutIfNeeded();
    EXPECT_EQ(name->frame(), (Rect{82, 28, 170, 22}));
    EXPECT_EQ(distance->frame(), (Rect{265, 28, 80, 22}));
    EXPECT_EQ(separator->frame(), (Rect{0, 78, 360, 0.5}));
}

TEST_F(RowLayoutTest, SameTextsAgain_ShapeAndPlaceNothing) {
    buildRow(400.0, 78.5);
    setTexts(6, 4, 5, 7);
    row->layoutIfNeeded();
    EXPECT_EQ(height(), 78.5);
    const int shaped = textEngine->count();
    setTexts(6, 4, 5, 7);
    row->layoutIfNeeded();
    EXPECT_EQ(height(), 78.5);
    EXPECT_EQ(textEngine->count(), shaped);
}

TEST_F(RowLayoutTest, RowsOfOneKind_AreLaidOutEachForItself) {
    buildRow(400.0, 78.5);
    setTexts(6, 4, 5, 7);
    const auto firstRow = row;
    const auto firstName = name;
    const auto firstDistance = distance;
    buildRow(300.0, 78.5);
    setTexts(60, 40, 2, 7);
    row->layoutIfNeeded();
    firstRow->layoutIfNeeded();
    EXPECT_EQ(name->frame(), (Rect{82, 28, 158, 22}));
    EXPECT_EQ(distance->frame(), (Rect{253, 28, 32, 22}));
    EXPECT_EQ(firstName->frame(), (Rect{82, 28, 210, 22}));
    EXPECT_EQ(firstDistance->frame(), (Rect{305, 28, 80, 22}));
    EXPECT_EQ(height(), 78.5);
}

TEST_F(RowLayoutTest, RowsInAStack_LieOneUnderTheOther) {
    const auto stack = create<StackView>(&StackView::initWithFrame, Rect{0, 0, 400, 157});
    buildRow(400.0, 0.0);
    row->setTranslatesAutoresizingMaskIntoConstraints(false);
    const auto first = row;
    stack->addArrangedSubview(row);
    buildRow(400.0, 0.0);
    stack->addArrangedSubview(row);
    stack->layoutIfNeeded();
    EXPECT_EQ(first->frame(), (Rect{0, 0, 400, 78.5}));
    EXPECT_EQ(row->frame(), (Rect{0, 78.5, 400, 78.5}));
    EXPECT_EQ(separator->frame(), (Rect{0, 78, 400, 0.5}));
    EXPECT_TRUE(debugLines().empty());
}

// --- a row with one wrapped text
// --------------------------------------------------------------------------------------

class LabelRowLayoutTest : public PlatformTest {
  protected:
    LabelRowLayoutTest() {
        row = create<View>(&View::initWithFrame, Rect{0, 0, 400, 0});
        label = create<Label>(&Label::initWithFrame, Rect{});
        label->setFont({FontFace::Text, FontWeight::Regular, 10.0});  // lines of 14
        label->setNumberOfLines(0);
        label->setLineBreakMode(LineBreakMode::WordWrapping);
        label->setTranslatesAutoresizingMaskIntoConstraints(false);
        label->setContentCompressionResistancePriority(1000.0, LayoutAxis::Vertical);
        label->setContentCompressionResistancePriority(1000.0, LayoutAxis::Horizontal);
        label->setContentHuggingPriority(1000.0, LayoutAxis::Vertical);
        row->addSubview(label);
        for (const char* format : {"H:|-margin-[label]-margin-|", "V:|-margin-[label]-margin-|"}) {
            row->addConstraints(
                VisualFormat::constraintsWithVisualFormat(format, {}, {{"margin", 15}}, {{"label", label}}));
        }
    }
    double height(double width) { return row->systemLayoutSizeFitting({width, 0.0}, 1000.0, 1.0).height; }

    std::shared_ptr<View> row;
    std::shared_ptr<Label> label;
};

TEST_F(LabelRowLayoutTest, FillsTheRowWithinItsMargins) {
    for (const bool rightToLeft : {false, true}) {
        assistant->rightToLeft = rightToLeft;
        label->setText("text");
        row->setFrame({0, 0, 400, rightToLeft ? 60.0 : 44.0});
        row->layoutIfNeeded();
        EXPECT_EQ(label->frame(), (Rect{15, 15, 370, row->frame().height - 30}));
    }
}

TEST_F(LabelRowLayoutTest, FittingHeight_IsThatOfTheWrappedText) {
    label->setText(glyphs(20) + " " + glyphs(20));  // 200 points a word
    EXPECT_EQ(height(500.0), 44.0);
    EXPECT_EQ(height(400.0), 58.0);
    EXPECT_EQ(height(230.0), 58.0);
    EXPECT_EQ(height(229.0), 86.0);  // 19 glyphs a line
    EXPECT_EQ(height(500.0), 44.0);
}

TEST_F(LabelRowLayoutTest, FittingHeight_OfNoText_IsOneLine) {
    EXPECT_EQ(height(400.0), 44.0);
}

TEST_F(LabelRowLayoutTest, InAStack_IsAsHighAsItsWrappedText) {
    const auto stack = create<StackView>(&StackView::initWithFrame, Rect{0, 0, 400, 58});
    stack->addArrangedSubview(row);
    label->setText(glyphs(20) + " " + glyphs(20));
    stack->layoutIfNeeded();
    EXPECT_EQ(row->frame(), (Rect{0, 0, 400, 58}));
    EXPECT_EQ(label->frame(), (Rect{15, 15, 370, 28}));
    stack->setFrame({0, 0, 500, 44});
    stack->layoutIfNeeded();
    EXPECT_EQ(row->frame(), (Rect{0, 0, 500, 44}));
    EXPECT_EQ(label->frame(), (Rect{15, 15, 470, 14}));
}

}  // namespace ktr::test
