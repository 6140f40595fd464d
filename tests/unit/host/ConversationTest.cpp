#include "host/conversation/ConversationView.h"

#include "host/conversation/Measures.h"
#include "platform/ui/Label.h"
#include "platform/ui/TapGestureRecognizer.h"
#include "tests/support/PlatformTest.h"

namespace ktr::host {

namespace {

using platform::create;
using platform::Rect;
using platform::View;

/// An answer of one row of a fixed height.
class FixedController : public platform::HostSnippetViewController {
  public:
    class Row : public View {
      public:
        platform::AccessibilityRole accessibilityRole() const override { return platform::AccessibilityRole::Link; }
        std::string accessibilityText() const override { return "row"; }
    };

    void loadView() override {
        row = create<Row>(&Row::initWithFrame, Rect{0.0, 0.0, 100.0, 10.0});
        setView(row);
    }
    double desiredHeightForWidth(double width) override {
        askedWidth = width;
        return height;
    }
    std::shared_ptr<platform::HeaderItem> sashItem() override {
        return std::make_shared<platform::HeaderItem>("Friends", nullptr);
    }
    void viewWillAppear(bool animated) override {
        HostSnippetViewController::viewWillAppear(animated);
        ++appearances;
    }

    bool isSearching() const override { return searching; }

    std::shared_ptr<Row> row;
    bool searching = false;
    double height = 200.0;
    double askedWidth = 0.0;
    int appearances = 0;
};

class KTRConversationTest : public test::PlatformTest {
  public:
    std::shared_ptr<TurnView> addTurn(const std::string& question = "where is ann",
                                      const std::string& sentence = "here") {
        auto turn = create<TurnView>(&TurnView::initWithFrame, Rect{});
        turn->setTexts({"Today, 17:42", "17:42", question, sentence});
        controller = create<FixedController>(&FixedController::init);
        turn->setController(controller);
        conversation->addTurn(turn);
        return turn;
    }
    /// Every glyph of the body font is 16 wide.
    static constexpr double kEm = 16.0;
    static constexpr double kLine = 22.0;

    std::shared_ptr<ConversationView> conversation = create<ConversationView>(&ConversationView::initWithFrame, Rect{});
    std::shared_ptr<FixedController> controller;
};

std::vector<Rect> framesBelow(const std::shared_ptr<View>& view) {
    std::vector<Rect> frames;
    for (const auto& child : view->subviews()) {
        frames.push_back(child->frameInRoot());
    }
    return frames;
}

TEST_F(KTRConversationTest, Phone_PlacesTimeQuestionSentenceAndCard) {
    const auto turn = addTurn();
    const double height = conversation->layOut(400.0);
    const auto speech = framesBelow(turn->subviews()[0]);
    EXPECT_EQ(speech[0], (Rect{12.0, 16.0, 376.0, 17.0}));
    // "where is ann" is 12 em: one line of 192, and 16 on either side.
    EXPECT_EQ(speech[1], (Rect{388.0 - 224.0, 45.0, 224.0, 43.0}));
    EXPECT_EQ(speech[2], (Rect{27.0, 102.0, 346.0, kLine}));
    EXPECT_EQ(turn->card()->frameInRoot(), (Rect{12.0, 134.0, 376.0, 248.0}));
    EXPECT_EQ(controller->askedWidth, 376.0);
    EXPECT_EQ(controller->appearances, 1);
    EXPECT_EQ(height, 134.0 + 248.0 + host::measures::kPhoneBottom);
}

TEST_F(KTRConversationTest, Phone_MirrorsFromRightToLeft) {
    assistant->rightToLeft = true;
    const auto turn = addTurn();
    conversation->layOut(400.0);
    const auto speech = framesBelow(turn->subviews()[0]);
    EXPECT_EQ(speech[1], (Rect{12.0, 45.0, 224.0, 43.0}));
    EXPECT_EQ(speech[2], (Rect{27.0, 102.0, 346.0, kLine}));
    EXPECT_EQ(turn->card()->frameInRoot(), (Rect{12.0, 134.0, 376.0, 248.0}));
}

TEST_F(KTRConversationTest, Header_StandsOnTheTwoAxes) {
    const auto turn = addTurn();
    conversation->layOut(400.0);
    const auto parts = turn->card()->subviews();
    EXPECT_EQ(parts[0]->frame(), (Rect{28.0, 11.0, 28.0, 28.0}));
    EXPECT_EQ(parts[1]->frame().x, 82.0);
    EXPECT_EQ(turn->card()->content()->frame(), (Rect{0.0, 48.0, 376.0, 200.0}));
    assistant->rightToLeft = true;
    conversation->layOut(420.0);
    EXPECT_EQ(parts[0]->frame(), (Rect{396.0 - 56.0, 11.0, 28.0, 28.0}));
    EXPECT_EQ(parts[1]->frame().maxX(), 396.0 - 82.0);
}

TEST_F(KTRConversationTest, Wide_PutsTheCardBesideItsQuestion) {
    const auto turn = addTurn();
    const double height = conversation->layOut(1100.0);
    const auto speech = framesBelow(turn->subviews()[0]);
    EXPECT_EQ(turn->card()->frameInRoot(), (Rect{380.0, 24.0, 680.0, 248.0}));
    EXPECT_EQ(speech[1], (Rect{356.0 - 224.0, 24.0, 224.0, 43.0}));
    EXPECT_EQ(speech[2].maxX(), 353.0);
    EXPECT_EQ(speech[2].y, 24.0 + 43.0 + 14.0);
    EXPECT_EQ(height, 24.0 + 248.0 + host::measures::kWideBottom);
}

TEST_F(KTRConversationTest, Wide_AddsMarginOnlyAndMirrors) {
    const auto turn = addTurn();
    conversation->layOut(1500.0);
    EXPECT_EQ(turn->card()->frameInRoot().x, 580.0);
    EXPECT_EQ(turn->card()->frameInRoot().width, 680.0);
    assistant->rightToLeft = true;
    conversation->layOut(1100.0);
    EXPECT_EQ(turn->card()->frameInRoot(), (Rect{40.0, 24.0, 680.0, 248.0}));
}

TEST_F(KTRConversationTest, Wide_BeginsAtNineHundred) {
    const auto turn = addTurn();
    conversation->layOut(899.0);
    EXPECT_EQ(turn->card()->frameInRoot().width, 875.0);
    conversation->layOut(900.0);
    EXPECT_EQ(turn->card()->frameInRoot(), (Rect{380.0, 24.0, 480.0, 248.0}));
}

TEST_F(KTRConversationTest, AWindowWithoutRoomShowsNoTimes) {
    const auto first = addTurn();
    conversation->setShowsTimes(false);
    conversation->layOut(400.0);
    EXPECT_TRUE(first->subviews()[0]->subviews()[0]->hidden());
    EXPECT_EQ(framesBelow(first->subviews()[0])[1].y, host::measures::kTimeAbove);
    conversation->setShowsTimes(true);
    conversation->layOut(400.0);
    EXPECT_FALSE(first->subviews()[0]->subviews()[0]->hidden());
}

TEST_F(KTRConversationTest, Turns_FollowWithTheirGap) {
    const auto first = addTurn();
    const auto second = addTurn("and mara", "");
    conversation->layOut(400.0);
    const auto speech = framesBelow(second->subviews()[0]);
    // Each turn says when it was asked, and only the first one of which day.
    EXPECT_FALSE(second->subviews()[0]->subviews()[0]->hidden());
    EXPECT_EQ(speech[0].y, first->card()->frameInRoot().maxY() + 22.0);
    EXPECT_EQ(speech[1].y, speech[0].maxY() + 12.0);
    EXPECT_EQ(second->card()->frameInRoot().y, speech[1].maxY() + 10.0);
}

TEST_F(KTRConversationTest, Question_OfTwoLinesIsBalanced) {
    // 20 glyphs at most on a line of 320: "aaaa bbbb cccc dddd" is 19, with "eeee" it is two lines.
    const std::string question = "aaaa bbbb cccc dddd eeee";
    const platform::Font body = platform::preferredFont(platform::TextStyle::Body);
    EXPECT_EQ(wrappedSize(question, body, 320.0).lines, 2u);
    const double width = balancedWidth(question, body, 320.0);
    EXPECT_EQ(width, 14.0 * kEm) << "aaaa bbbb cccc";
    EXPECT_EQ(wrappedSize(question, body, width).lines, 2u);
    EXPECT_EQ(wrappedSize(question, body, width - 1.0).lines, 3u);
}

TEST_F(KTRConversationTest, Question_OfOneLineOrFourIsNot) {
    const platform::Font body = platform::preferredFont(platform::TextStyle::Body);
    EXPECT_EQ(balancedWidth("short", body, 320.0), 5.0 * kEm);
    EXPECT_EQ(balancedWidth("aaaa bbbb cccc dddd", body, 4.0 * kEm), 4.0 * kEm);
    EXPECT_EQ(balancedWidth("", body, 320.0), 0.0);
}

TEST_F(KTRConversationTest, Question_NeverBreaksAWordForBalance) {
    const platform::Font body = platform::preferredFont(platform::TextStyle::Body);
    const double width = balancedWidth("aa bbbbbbbbbbbb", body, 13.0 * kEm);
    EXPECT_EQ(width, 12.0 * kEm);
}

TEST_F(KTRConversationTest, JapaneseSentence_IsNoNarrowerThanItsWidestPhrase) {
    const platform::Font body = platform::preferredFont(platform::TextStyle::Body);
    // "今、" and a phrase of seven letters: five on each of two lines would be narrower.
    ASSERT_EQ(wrappedSize("今、見守っています", body, 8.0 * kEm).lines, 2u);
    EXPECT_EQ(balancedWidth("今、見守っています", body, 8.0 * kEm), 7.0 * kEm);
    EXPECT_LT(balancedWidth("今、見守っています", body, 6.0 * kEm), 7.0 * kEm) << "it cannot be whole there";
}

TEST_F(KTRConversationTest, Sentence_RunsAsItsLanguageDoesWhoeverItBeginsWith) {
    const auto said = [this](const std::string& sentence) {
        const auto answer = addTurn("where", sentence)->subviews()[0]->subviews()[2];
        return std::dynamic_pointer_cast<platform::Label>(answer->subviews()[0])->text();
    };
    EXPECT_EQ(said("Ann is here"), "Ann is here");
    EXPECT_EQ(said("\u0644\u064A\u0644\u0649 is here"), "\u200E\u0644\u064A\u0644\u0649 is here");
    EXPECT_EQ(said("\u0644\u064A\u0644\u0649"), "\u0644\u064A\u0644\u0649") << "in another language";
    assistant->rightToLeft = true;
    EXPECT_EQ(said("Ann \u0647\u0646\u0627"), "\u200FAnn \u0647\u0646\u0627");
    EXPECT_EQ(said("\u0647\u0646\u0627 Ann"), "\u0647\u0646\u0627 Ann");
    EXPECT_EQ(said("Ann is here"), "Ann is here");
}

TEST_F(KTRConversationTest, Ring_ShowsWhileTheControllerSearches) {
    const auto turn = addTurn();
    conversation->layOut(400.0);
    EXPECT_TRUE(turn->card()->ring()->hidden());
    controller->searching = true;
    conversation->layOut(400.0);
    EXPECT_FALSE(turn->card()->ring()->hidden());
    EXPECT_EQ(turn->card()->ring()->frame(), (Rect{376.0 - 36.0, 15.0, 18.0, 18.0}));
    controller->searching = false;
    turn->card()->updateRing();
    EXPECT_TRUE(turn->card()->ring()->hidden());
}

TEST_F(KTRConversationTest, ReadingOrder_IsQuestionSentenceThenCardAlsoSideBySide) {
    const auto turn = addTurn();
    controller->height = 10.0;  // a card that ends above the sentence
    for (const bool rightToLeft : {false, true}) {
        assistant->rightToLeft = rightToLeft;
        conversation->layOut(1100.0);
        const auto tree = platform::accessibilityTree(conversation, rightToLeft);
        ASSERT_EQ(tree.children.size(), 1u);
        const auto& parts = tree.children[0].children;
        ASSERT_EQ(parts.size(), 2u);
        EXPECT_EQ(tree.children[0].text, "where is ann");
        ASSERT_GE(parts[0].children.size(), 2u);
        EXPECT_EQ(parts[0].children[0].text, "ANNOUNCE_QUESTION");
        EXPECT_EQ(parts[0].children[0].children.at(0).text, "where is ann");
        EXPECT_EQ(parts[0].children[1].text, "ANNOUNCE_ANSWER");
        EXPECT_EQ(parts[0].children[1].children.at(0).text, "here");
        EXPECT_EQ(parts[1].text, "Friends");
        EXPECT_EQ(parts[1].children[0].text, "Friends");
        EXPECT_EQ(parts[1].children[1].text, "row");
    }
}

TEST_F(KTRConversationTest, ReadAloud_QuestionWithoutASentenceHasNoAnswer) {
    const auto turn = addTurn();
    turn->setSentence("");
    conversation->layOut(400.0);
    const auto tree = platform::accessibilityTree(conversation, false);
    const auto& speech = tree.children.at(0).children.at(0);
    for (const auto& part : speech.children) {
        EXPECT_NE(part.text, "ANNOUNCE_ANSWER");
    }
}

TEST_F(KTRConversationTest, Motion_NothingMovesUnlessAsked) {
    const auto turn = addTurn();
    turn->arrive(0.0);
    turn->answerArrives(0.0);
    conversation->layOut(400.0);
    controller->height = 300.0;
    conversation->layOut(400.0);
    EXPECT_FALSE(conversation->advance(0.01));
    EXPECT_EQ(turn->cardOpacity(), 1.0);
    EXPECT_EQ(turn->rise(), 0.0);
    EXPECT_EQ(turn->card()->frameInRoot(), (Rect{12.0, 134.0, 376.0, 348.0}));
}

TEST_F(KTRConversationTest, Motion_TurnRisesAndFadesIn) {
    conversation->setMotionStyle(MotionStyle::Full);
    addTurn();
    const auto turn = addTurn();
    conversation->layOut(400.0);
    const double place = turn->frame().y;
    turn->arrive(5.0);
    EXPECT_TRUE(conversation->advance(5.0));
    EXPECT_EQ(turn->frame().y, place + motions::kRise);
    EXPECT_EQ(conversation->topOf(*turn), place) << "scrolling goes where the turn will be";
    EXPECT_EQ(turn->cardOpacity(), 0.0);
    double before = turn->frame().y;
    for (double now = 5.0; now < 5.0 + motions::kArrival; now += 0.016) {
        conversation->advance(now);
        EXPECT_LE(turn->frame().y, before) << "it never turns round";
        before = turn->frame().y;
    }
    EXPECT_FALSE(conversation->advance(5.0 + motions::kArrival));
    EXPECT_EQ(turn->frame().y, place);
    EXPECT_EQ(turn->cardOpacity(), 1.0);
    EXPECT_FALSE(conversation->advance(6.0));
}

TEST_F(KTRConversationTest, Motion_LittleMotionOnlyFades) {
    conversation->setMotionStyle(MotionStyle::Reduced);
    const auto turn = addTurn();
    conversation->layOut(400.0);
    turn->arrive(5.0);
    EXPECT_TRUE(conversation->advance(5.01));
    EXPECT_EQ(turn->rise(), 0.0);
    EXPECT_GT(turn->cardOpacity(), 0.0);
    EXPECT_LT(turn->cardOpacity(), 1.0);
    controller->height = 300.0;
    conversation->layOut(400.0);
    EXPECT_EQ(turn->card()->frameInRoot().height, 348.0) << "its height is there at once";
    EXPECT_FALSE(conversation->advance(5.0 + motions::kFade));
}

TEST_F(KTRConversationTest, Motion_CardGrowsToItsHeightAndPushesWhatIsBelow) {
    conversation->setMotionStyle(MotionStyle::Full);
    const auto first = addTurn();
    const auto growing = controller;
    const auto second = addTurn();
    conversation->layOut(400.0);
    const Rect card = first->card()->frameInRoot();
    const double below = second->frame().y;
    conversation->advance(9.0);
    growing->height = 300.0;
    conversation->layOut(400.0);
    EXPECT_EQ(first->card()->frameInRoot(), card) << "it grows from where it was";
    EXPECT_EQ(second->frame().y, below);
    EXPECT_TRUE(conversation->advance(9.0 + motions::kGrowth / 2.0));
    const double half = first->card()->frameInRoot().height;
    EXPECT_GT(half, card.height);
    EXPECT_LT(half, card.height + 100.0);
    EXPECT_EQ(first->card()->frameInRoot().y, card.y) << "its top stays";
    EXPECT_DOUBLE_EQ(second->frame().y, below + half - card.height);
    // Another height meanwhile: it goes on from where it is.
    growing->height = 200.0;
    conversation->layOut(400.0);
    EXPECT_DOUBLE_EQ(first->card()->frameInRoot().height, half);
    EXPECT_FALSE(conversation->advance(20.0));
    EXPECT_EQ(first->card()->frameInRoot(), card);
    EXPECT_EQ(second->frame().y, below);
}

TEST_F(KTRConversationTest, Motion_AnotherWidthIsNoGrowth) {
    conversation->setMotionStyle(MotionStyle::Full);
    const auto turn = addTurn();
    conversation->layOut(400.0);
    controller->height = 300.0;
    conversation->layOut(500.0);
    EXPECT_EQ(turn->card()->frameInRoot().height, 348.0);
    EXPECT_FALSE(conversation->advance(0.01));
}

}  // namespace

}  // namespace ktr::host
