// The building blocks of pages: what they say, how they are used without a mouse, and that nothing of them is cut.
// `fill` is long: it has each of them once.
#include <QAccessible>
#include <QAccessibleInterface>
#include <QApplication>
#include <QKeyEvent>
#include <QMouseEvent>
#include <QPainter>
#include <memory>
#include <string>

#include "app/window/blocks/Button.h"
#include "app/window/blocks/Column.h"
#include "app/window/blocks/Flow.h"
#include "app/window/blocks/FormField.h"
#include "app/window/blocks/ListCard.h"
#include "app/window/blocks/PageBar.h"
#include "app/window/blocks/Pill.h"
#include "app/window/blocks/StepRow.h"
#include "app/window/blocks/Words.h"
#include "linux/paint/AvatarImage.h"
#include "linux/paint/PersonColors.h"
#include "tests/unit/app/TestHost.h"

#include <gtest/gtest.h>

namespace ktr::app {

namespace {

using linux_::ColorScheme;
using linux_::Contrast;
using linux_::Palette;
using platform::ContentSizeCategory;

std::shared_ptr<const linux_::QtImage> face(double diameter) {
    platform::Contact mara;
    mara.givenName = "Mara";
    mara.familyName = "Lind";
    return linux_::AvatarImage::letters(diameter, linux_::Initials(mara),
                                        linux_::PersonColors::color(linux_::PersonColors::number("mara")));
}

/// The paper that blocks lie on.
class Paper : public Column {
  public:
    void paintEvent(QPaintEvent* event) override {
        QPainter painter(this);
        painter.fillRect(rect(), colors().window);
        painter.end();
        Column::paintEvent(event);
    }
};

class KTRBlocksTest : public ::testing::Test {
  protected:
    void open(ContentSizeCategory size = ContentSizeCategory::L, const std::string& language = "en-GB") {
        paper = nullptr;
        host = nullptr;
        host::HostOptions options;
        options.language = language;
        options.textSize = size;
        host = testHost(options);
        ASSERT_TRUE(host);
        paper = std::make_unique<Paper>();
        paper->setLayoutDirection(host->rightToLeft() ? Qt::RightToLeft : Qt::LeftToRight);
    }
    void TearDown() override {
        paper = nullptr;
        host = nullptr;
    }
    template <typename Made, typename... Arguments>
    Made* add(Column::Place place, Arguments&&... arguments) {
        auto* made = new Made(std::forward<Arguments>(arguments)...);
        paper->add(made, place);
        return made;
    }
    /// One of each kind, in every state that can be seen.
    void fill();
    void lay(int width, const Palette& palette) {
        paper->resize(width, 10);
        paper->setLook({&palette, true});
        paper->resize(width, paper->shapeHeight(width));
        paper->show();
        QApplication::processEvents();
        paper->resize(width, paper->shapeHeight(width));
        QApplication::processEvents();
    }
    static void key(QWidget& widget, int code) {
        QKeyEvent press(QEvent::KeyPress, code, Qt::NoModifier);
        QApplication::sendEvent(&widget, &press);
        QKeyEvent release(QEvent::KeyRelease, code, Qt::NoModifier);
        QApplication::sendEvent(&widget, &release);
    }
    static void mouse(QWidget& widget, QEvent::Type type, QPointF at) {
        QMouseEvent event(type, at, widget.mapToGlobal(at), Qt::LeftButton, Qt::LeftButton, Qt::NoModifier);
        QApplication::sendEvent(&widget, &event);
    }
    static QAccessibleInterface& heard(QWidget& widget) { return *QAccessible::queryAccessibleInterface(&widget); }

    std::unique_ptr<host::Host> host;
    std::unique_ptr<Paper> paper;
    Button* main = nullptr;
    ListRow* toggle = nullptr;
};

void KTRBlocksTest::fill() {
    const auto tr = [](const char* text) { return QString::fromUtf8(text); };
    auto* bar = add<PageBar>({0, 0, 0});
    bar->setTexts(tr("Settings"), tr("Back"));
    add<Words>({8, 27, 27}, BlockStyle::Title)->setText(tr("Three things need a hand and one more."));
    auto* line = add<Words>({6, 27, 27}, BlockStyle::Body, Words::Tone::Soft);
    line->setText(tr("Sign in to the service you share places on. It can be your own."));
    line->setBalanced(true);
    auto* field = add<FormField>({24});
    field->setLabel(tr("Service address"));
    field->setHint(tr("brin.example"));
    auto* wrong = add<FormField>({14});
    wrong->setLabel(tr("Secret"));
    wrong->setSecret(tr("Show the secret"), tr("Hide the secret"));
    wrong->setText(tr("geheimnisvoll"));
    wrong->setNote(tr("The service doesn’t know this person and secret together. Check both, or ask for a new link."));
    main = add<Button>({22}, Button::Kind::Main, tr("Sign in"));
    auto* busy = new Button(Button::Kind::Main, tr("Checking…"));
    busy->setBusy(true);
    auto* flow = add<Flow>({8});
    flow->setFilling(true);
    flow->add(busy);
    flow->add(new Button(Button::Kind::Quiet, tr("Cancel")));
    add<Button>({8}, Button::Kind::Main, tr("Sign in"))->setEnabled(false);
    auto* quiet = add<Flow>({12, 27, 27});
    quiet->add(new Button(Button::Kind::Quiet, tr("Try again"), Icon::Again));
    quiet->add(new Button(Button::Kind::Quiet, tr("Call"), Icon::Call));
    add<Button>({8, 27, 27, false, true}, Button::Kind::Text, tr("I have a link"));
    auto* card = add<ListCard>({8});
    auto* person = new ListRow(ListRow::Kind::Leads, tr("Mara Lind"));
    person->setFace(face(54));
    person->setSecond(tr("mara@brin.example"));
    card->add(person);
    toggle = new ListRow(ListRow::Kind::Switch, tr("Friends can see me"));
    toggle->setSecond(tr("Three people, as you allowed"));
    toggle->setChecked(true);
    card->add(toggle);
    card->add(new ListRow(ListRow::Kind::Switch, tr("Say answers aloud")));
    auto* step = new StepRow;
    step->setTexts({tr("Text size"), tr("Smaller"), tr("Larger")});
    step->setValue(tr("Standard"));
    card->add(step);
    auto* value = new ListRow(ListRow::Kind::Leads, tr("Distances"));
    value->setValue(tr("Kilometres"));
    card->add(value);
    card->add(new ListRow(ListRow::Kind::Adds, tr("Add a region")));
    auto* choices = add<ListCard>({20});
    choices->setParted(false);
    choices->add(new ListRow(ListRow::Kind::Choice, tr("Exactly")));
    auto* chosen = new ListRow(ListRow::Kind::Choice, tr("The town"));
    chosen->setChecked(true);
    choices->add(chosen);
    auto* fine = new ListRow(ListRow::Kind::Fine, tr("Service"));
    fine->setValue(tr("brin.example, 38 ms"));
    choices->add(fine);
    auto* people = add<Flow>({12, 27, 27});
    people->add(new PersonPill(tr("Ann Marsh"), face(36)));
    people->add(new PersonPill(tr("Lea Marsh"), face(36)));
    auto* questions = add<Flow>({20}, 10);
    questions->setAtEnd(true);
    questions->add(new UnaskedQuestion(tr("Where is Ann?")));
    questions->add(new UnaskedQuestion(tr("Tell me when Noam leaves work")));
    paper->setMargins(0, 20);
}

}  // namespace

/// KTR_GALLERY names a folder for the pictures.
TEST_F(KTRBlocksTest, Gallery_EveryAppearanceFitsItsWidth) {
    struct Appearance {
        const char* name;
        ColorScheme scheme;
        Contrast contrast;
        const char* language;
        ContentSizeCategory size;
        int width;
    };
    const Appearance appearances[] = {
        {"light", ColorScheme::Light, Contrast::Normal, "en-GB", ContentSizeCategory::L, 400},
        {"dark", ColorScheme::Dark, Contrast::Normal, "en-GB", ContentSizeCategory::L, 400},
        {"high", ColorScheme::Light, Contrast::High, "en-GB", ContentSizeCategory::L, 400},
        {"rtl", ColorScheme::Dark, Contrast::High, "ar", ContentSizeCategory::L, 400},
        {"narrow", ColorScheme::Light, Contrast::Normal, "en-GB", ContentSizeCategory::XL, 320},
        {"ax3", ColorScheme::Light, Contrast::Normal, "en-GB", ContentSizeCategory::AX3, 400},
        {"ax5-rtl", ColorScheme::Dark, Contrast::Normal, "ar", ContentSizeCategory::AX5, 320},
    };
    for (const Appearance& appearance : appearances) {
        open(appearance.size, appearance.language);
        fill();
        lay(appearance.width, Palette::of(appearance.scheme, appearance.contrast));
        main->setFocus(Qt::TabFocusReason);
        for (QWidget* widget : paper->findChildren<QWidget*>()) {
            auto* block = dynamic_cast<Block*>(widget);
            if (block == nullptr || !block->isVisible()) {
                continue;
            }
            const QPoint at = block->mapTo(paper.get(), block->shape().topLeft());
            EXPECT_GE(at.x(), 0) << appearance.name;
            EXPECT_LE(at.x() + block->shape().width(), appearance.width) << appearance.name;
            EXPECT_GE(block->shape().height(), block->shapeHeight(block->shape().width()) - 1)
                << appearance.name << ": " << block->accessibleName().toStdString();
        }
        keepPicture(*paper, appearance.name);
    }
}

TEST_F(KTRBlocksTest, Shadows_AreBlurredOnceForAllCardsAndPaintings) {
    open();
    for (int card = 0; card < 3; ++card) {
        add<ListCard>({20})->add(new ListRow(ListRow::Kind::Plain, QStringLiteral("Units")));
    }
    lay(400, Palette::of(ColorScheme::Light));
    paper->grab();
    // Two lie under each card.
    EXPECT_EQ(paper->shadow().blurs(), 2U);
    paper->grab();
    lay(520, Palette::of(ColorScheme::Light));
    paper->grab();
    EXPECT_EQ(paper->shadow().blurs(), 2U);
}

TEST_F(KTRBlocksTest, Button_IsPressedByKeysMouseAndAssistiveTechnology) {
    open();
    auto* button = add<Button>({}, Button::Kind::Quiet, QStringLiteral("Try again"));
    int pressed = 0;
    button->setPressed([&pressed] { ++pressed; });
    lay(400, Palette::of(ColorScheme::Light));
    key(*button, Qt::Key_Space);
    key(*button, Qt::Key_Return);
    EXPECT_EQ(pressed, 2);
    mouse(*button, QEvent::MouseButtonPress, {20, 20});
    EXPECT_EQ(pressed, 2) << "on release";
    mouse(*button, QEvent::MouseButtonRelease, {20, 20});
    EXPECT_EQ(pressed, 3);
    mouse(*button, QEvent::MouseButtonPress, {20, 20});
    mouse(*button, QEvent::MouseMove, {20, 200});
    mouse(*button, QEvent::MouseButtonRelease, {20, 200});
    EXPECT_EQ(pressed, 3) << "let go of elsewhere";
    auto& spoken = heard(*button);
    EXPECT_EQ(spoken.text(QAccessible::Name), QStringLiteral("Try again"));
    EXPECT_EQ(spoken.role(), QAccessible::Button);
    ASSERT_NE(spoken.actionInterface(), nullptr);
    spoken.actionInterface()->doAction(QAccessibleActionInterface::pressAction());
    EXPECT_EQ(pressed, 4);
    button->setEnabled(false);
    spoken.actionInterface()->doAction(QAccessibleActionInterface::pressAction());
    mouse(*button, QEvent::MouseButtonPress, {20, 20});
    mouse(*button, QEvent::MouseButtonRelease, {20, 20});
    EXPECT_EQ(pressed, 4);
}

TEST_F(KTRBlocksTest, Switch_SaysItsStateAndThatItChanged) {
    open();
    auto* card = add<ListCard>({});
    auto* row = new ListRow(ListRow::Kind::Switch, QStringLiteral("Say answers aloud"));
    card->add(row);
    lay(400, Palette::of(ColorScheme::Light));
    auto& spoken = heard(*row);
    EXPECT_EQ(spoken.role(), QAccessible::CheckBox);
    EXPECT_TRUE(spoken.state().checkable);
    EXPECT_FALSE(spoken.state().checked);
    row->setChecked(true);
    EXPECT_TRUE(spoken.state().checked);
    row->setHeld(true);
    EXPECT_EQ(spoken.actionInterface(), nullptr) << "what is held offers nothing";
    EXPECT_EQ(row->focusPolicy(), Qt::NoFocus);
}

TEST_F(KTRBlocksTest, WrongField_SaysWhatIsWrongToReadersToo) {
    open();
    auto* field = add<FormField>({});
    field->setLabel(QStringLiteral("Secret"));
    const int before = field->shapeHeight(376);
    field->setNote(QStringLiteral("Nothing answers at brin.example."));
    EXPECT_GT(field->shapeHeight(376), before);
    auto& spoken = heard(field->edit());
    EXPECT_EQ(spoken.text(QAccessible::Name), QStringLiteral("Secret"));
    EXPECT_EQ(spoken.text(QAccessible::Description), QStringLiteral("Nothing answers at brin.example."));
    field->setNote({});
    EXPECT_EQ(field->shapeHeight(376), before);
}

TEST_F(KTRBlocksTest, SecretField_IsDotsUntilTheEyeIsPressed) {
    open();
    auto* field = add<FormField>({});
    field->setSecret(QStringLiteral("Show the secret"), QStringLiteral("Hide the secret"));
    IconButton* eye = nullptr;
    for (QWidget* child : field->findChildren<QWidget*>()) {
        eye = eye == nullptr ? dynamic_cast<IconButton*>(child) : eye;
    }
    ASSERT_NE(eye, nullptr);
    EXPECT_EQ(field->edit().echoMode(), QLineEdit::Password);
    EXPECT_EQ(eye->accessibleName(), QStringLiteral("Show the secret"));
    eye->press();
    EXPECT_EQ(field->edit().echoMode(), QLineEdit::Normal);
    EXPECT_EQ(eye->accessibleName(), QStringLiteral("Hide the secret"));
}

TEST_F(KTRBlocksTest, Pills_StandBelowEachOtherWhereTheyDoNotFit) {
    open();
    Flow flow;
    flow.add(new Button(Button::Kind::Quiet, QStringLiteral("Call somebody")));
    flow.add(new Button(Button::Kind::Quiet, QStringLiteral("Write to them")));
    EXPECT_GT(flow.shapeHeight(200), flow.shapeHeight(400));
    flow.resize(200 + 12, flow.shapeHeight(200) + 12);
    flow.show();
    EXPECT_EQ(flow.blocks()[0]->x(), flow.blocks()[1]->x());
    EXPECT_LT(flow.blocks()[0]->y(), flow.blocks()[1]->y());
}

}  // namespace ktr::app
