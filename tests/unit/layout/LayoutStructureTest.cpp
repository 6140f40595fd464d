// What scopes of one kind share, and that sharing stays their own affair.
#include "platform/layout/LayoutStructure.h"

#include <functional>

#include "platform/layout/LayoutConstraint.h"
#include "platform/layout/LayoutScope.h"
#include "platform/ui/Label.h"
#include "tests/support/PlatformTest.h"
#include "tests/unit/layout/PrintRect.h"

namespace ktr::test {

using namespace platform;

class LayoutStructureTest : public PlatformTest {
  protected:
    /// A row with a text between its margins.
    struct Row {
        std::shared_ptr<View> view;
        std::shared_ptr<Label> label;
        std::shared_ptr<LayoutScope> scope;
    };

    static std::vector<ConstraintRule> rulesOf(View& view, Label& label) {
        return {label.leadingAnchor().constraintEqualTo(view.leadingAnchor(), 15.0)->rule(),
                view.trailingAnchor().constraintGreaterThanOrEqualTo(label.trailingAnchor(), 15.0)->rule(),
                label.topAnchor().constraintEqualTo(view.topAnchor(), 10.0)->rule()};
    }
    static Row row(
        const std::string& text, double width = 400.0,
        const std::function<void(Label&, std::vector<ConstraintRule>&)>& change = [](auto&, auto&) {}) {
        Row row;
        row.view = create<View>(&View::initWithFrame, Rect{0.0, 0.0, width, 40.0});
        row.label = create<Label>(&Label::initWithFrame, Rect{});
        row.label->setFont({FontFace::Text, FontWeight::Regular, 10.0});
        row.label->setTranslatesAutoresizingMaskIntoConstraints(false);
        row.label->setText(text);
        row.view->addSubview(row.label);
        row.scope = std::make_shared<LayoutScope>(*row.view);
        auto rules = rulesOf(*row.view, *row.label);
        change(*row.label, rules);
        row.scope->add(rules);
        row.scope->layout();
        return row;
    }
    static std::vector<Row> rows(int count) {
        std::vector<Row> rows;
        for (int i = 0; i < count; ++i) {
            rows.push_back(row(std::string(1 + static_cast<std::size_t>(i % 30), 'x'), 350.0 + i));
        }
        return rows;
    }
    /// Lays all rows out, as after a change that may be anybody's: those that were solved again.
    static std::vector<std::size_t> solvedAgain(const std::vector<Row>& rows) {
        std::vector<std::size_t> again;
        for (std::size_t i = 0; i < rows.size(); ++i) {
            const int before = rows[i].scope->solves();
            rows[i].scope->invalidate();
            rows[i].scope->layout();
            if (rows[i].scope->solves() != before) {
                again.push_back(i);
            }
        }
        return again;
    }
};

TEST_F(LayoutStructureTest, RowsOfOneKind_ShareOneElimination) {
    const auto all = rows(50);
    for (std::size_t i = 0; i < all.size(); ++i) {
        EXPECT_EQ(all[i].scope->structure(), all[0].scope->structure());
        EXPECT_EQ(all[i].label->frame(), (Rect{15, 10, 10.0 * static_cast<double>(1 + i % 30), 14}));
    }
    EXPECT_EQ(all[0].scope->structure()->runs(), 1);
}

TEST_F(LayoutStructureTest, FirstTextThatIsCut_IsSolvedOnceForAll) {
    const auto all = rows(10);
    const auto structure = all[0].scope->structure();
    all[3].label->setText(std::string(50, 'x'));
    EXPECT_EQ(solvedAgain(all), std::vector<std::size_t>{3});
    EXPECT_EQ(all[3].label->frame().width, 353.0 - 30.0);
    EXPECT_EQ(structure->runs(), 2);
    all[5].label->setText(std::string(60, 'x'));
    EXPECT_EQ(solvedAgain(all), std::vector<std::size_t>{5});
    EXPECT_EQ(all[5].label->frame().width, 355.0 - 30.0);
    EXPECT_EQ(structure->runs(), 2);
}

TEST_F(LayoutStructureTest, ChangedTextOrWidth_SolvesItsRowAlone) {
    const auto all = rows(20);
    EXPECT_TRUE(solvedAgain(all).empty());
    all[7].label->setText("another text");
    EXPECT_EQ(solvedAgain(all), std::vector<std::size_t>{7});
    all[12].view->setFrame({0.0, 0.0, 300.0, 40.0});
    EXPECT_EQ(solvedAgain(all), std::vector<std::size_t>{12});
    all[3].label->setText(all[3].label->text());
    EXPECT_TRUE(solvedAgain(all).empty());
    EXPECT_EQ(all[0].scope->structure()->runs(), 1);
}

TEST_F(LayoutStructureTest, HiddenText_KeepsItsPlace_AndNoRowIsSolvedAgain) {
    const auto all = rows(5);
    const Rect before = all[2].label->frame();
    all[2].label->setHidden(true);
    EXPECT_TRUE(solvedAgain(all).empty());
    EXPECT_EQ(all[2].label->frame(), before);
}

TEST_F(LayoutStructureTest, RowsThatSayAnythingElse_HaveAnother) {
    const auto one = row("text");
    const std::vector<std::function<void(Label&, std::vector<ConstraintRule>&)>> changes = {
        [](Label&, auto& rules) { rules[0].terms.constant = 16.0; },
        [](Label&, auto& rules) { rules[0].terms.priority = 999.0; },
        [](Label&, auto& rules) { rules[0].terms.relation = LayoutRelation::GreaterOrEqual; },
        [](Label&, auto& rules) { rules[0].terms.multiplier = 2.0; },
        [](Label&, auto& rules) { rules[0].terms.first = LayoutAttribute::CenterX; },
        [](Label&, auto& rules) { std::swap(rules[0], rules[2]); },
        [](Label&, auto& rules) { rules.pop_back(); },
        [](Label& label, auto&) { label.setContentHuggingPriority(251.0, LayoutAxis::Horizontal); },
        [](Label& label, auto&) { label.setTranslatesAutoresizingMaskIntoConstraints(true); },
    };
    for (std::size_t i = 0; i < changes.size(); ++i) {
        EXPECT_NE(row("text", 400.0, changes[i]).scope->structure(), one.scope->structure()) << "change " << i;
    }
    EXPECT_EQ(row("longer", 300.0).scope->structure(), one.scope->structure());
}

TEST_F(LayoutStructureTest, GoesWithTheLastOfItsRows) {
    auto all = rows(3);
    const std::weak_ptr<LayoutStructure> structure = all[0].scope->structure();
    all.pop_back();
    all.erase(all.begin());
    EXPECT_FALSE(structure.expired());
    all.clear();
    EXPECT_TRUE(structure.expired());
}

// A list is measured at each answer: what a content costs to measure is paid once.
TEST_F(LayoutStructureTest, ContentThatChanged_IsMeasuredOnce) {
    struct Counting : View {
        IntrinsicSize intrinsicContentSize(double) const override {
            ++measured;
            return {width, 20.0};
        }
        double width = 50.0;
        mutable int measured = 0;
    };
    const auto view = create<View>(&View::initWithFrame, Rect{0.0, 0.0, 400.0, 40.0});
    const auto content = std::make_shared<Counting>();
    content->setTranslatesAutoresizingMaskIntoConstraints(false);
    view->addSubview(content);
    view->addConstraint(content->leadingAnchor().constraintEqualTo(view->leadingAnchor(), 15.0));
    view->layoutIfNeeded();
    EXPECT_EQ(content->frame().width, 50.0);
    content->measured = 0;
    content->width = 60.0;
    content->invalidateIntrinsicContentSize();
    view->layoutIfNeeded();
    EXPECT_EQ(content->frame().width, 60.0);
    EXPECT_EQ(content->measured, 1);
}

}  // namespace ktr::test
