#include "host/conversation/OffersView.h"

#include "host/conversation/ConversationView.h"
#include "host/conversation/Measures.h"
#include "platform/ui/Accessibility.h"
#include "platform/ui/TouchDispatcher.h"
#include "tests/support/PlatformTest.h"

namespace ktr::host {

namespace {

using platform::create;
using platform::Rect;

class KTROffersTest : public test::PlatformTest {
  public:
    void addTurn(const std::string& sentence, const Offers& offers) {
        turn = create<TurnView>(&TurnView::initWithFrame, Rect{});
        turn->setTexts({"Today, 17:42", "17:42", "where is ann", sentence});
        turn->setOffers(offers);
        conversation->addTurn(turn);
    }
    Offer button(const std::string& words) {
        return {Offer::Kind::Button, words, [this, words] { pressed.push_back(words); }};
    }
    Rect frameOf(std::size_t offer) const { return turn->offers()->offers().at(offer)->frameInRoot(); }

    std::shared_ptr<ConversationView> conversation = create<ConversationView>(&ConversationView::initWithFrame, Rect{});
    std::shared_ptr<TurnView> turn;
    std::vector<std::string> pressed;
};

}  // namespace

TEST_F(KTROffersTest, Buttons_StandSideBySideBelowTheSentence) {
    addTurn("here", {{button("Call"), button("Write")}});
    const double height = conversation->layOut(400.0);
    // The sentence is a line of 22 at 102; 12 below it a button of 44 begins at the sentence's edge.
    EXPECT_EQ(frameOf(0), (Rect{27.0, 136.0, 4 * 16.0 + 32.0, 44.0}));
    EXPECT_EQ(frameOf(1), (Rect{27.0 + 96.0 + 8.0, 136.0, 5 * 16.0 + 32.0, 44.0}));
    EXPECT_EQ(height, 180.0 + measures::kOffersToQuestion + measures::kPhoneBottom);
}

TEST_F(KTROffersTest, ButtonsThatDoNotFit_StandBelowEachOther) {
    addTurn("here", {{button("Call Kwame Mensah"), button("Write")}});
    conversation->layOut(400.0);
    EXPECT_EQ(frameOf(0).x, 27.0);
    EXPECT_EQ(frameOf(1), (Rect{27.0, 136.0 + 44.0 + 8.0, 5 * 16.0 + 32.0, 44.0}));
}

TEST_F(KTROffersTest, Questions_KeepToTheEdgeAtWhichTheQuestionStands) {
    Offers offers{{{Offer::Kind::Question, "Where?"}, {Offer::Kind::Question, "Who?"}}, "You could ask"};
    addTurn("here", offers);
    conversation->layOut(400.0);
    EXPECT_EQ(frameOf(0).maxX(), 388.0);
    EXPECT_EQ(frameOf(1).maxX(), 388.0);
    EXPECT_EQ(frameOf(1).y, frameOf(0).maxY() + 10.0);
    EXPECT_GT(frameOf(0).y, 124.0 + measures::kSentenceToQuestions) << "the title stands above";
}

TEST_F(KTROffersTest, RightToLeft_Mirrors) {
    assistant->rightToLeft = true;
    addTurn("here", {{button("Call"), button("Write")}});
    conversation->layOut(400.0);
    EXPECT_EQ(frameOf(0).maxX(), 400.0 - 27.0);
    EXPECT_EQ(frameOf(1).maxX(), frameOf(0).x - 8.0);
}

TEST_F(KTROffersTest, Wide_StandUnderTheSentenceInItsColumn) {
    addTurn("here", {{button("Call")}});
    conversation->layOut(1100.0);
    EXPECT_EQ(frameOf(0).maxX(), 353.0);
}

TEST_F(KTROffersTest, PressAndReading_EachOnce) {
    addTurn("here", {{button("Call"), button("Write")}});
    conversation->layOut(400.0);
    platform::TouchDispatcher touches(conversation);
    const Rect second = frameOf(1);
    touches.press({second.x + 5.0, second.y + 5.0}, 0.0);
    touches.release({second.x + 5.0, second.y + 5.0}, 0.1);
    EXPECT_EQ(pressed, (std::vector<std::string>{"Write"}));
    const auto tree = platform::accessibilityTree(turn, false);
    std::vector<std::string> links;
    for (const auto& part : tree.children) {
        for (const auto& node : part.children) {
            if (node.role == platform::AccessibilityRole::Link) {
                EXPECT_TRUE(node.pressable);
                links.push_back(node.text);
            }
        }
    }
    EXPECT_EQ(links, (std::vector<std::string>{"Call", "Write"}));
}

TEST_F(KTROffersTest, OffersThatGo_LeaveNothing) {
    addTurn("here", {{button("Call")}});
    conversation->layOut(400.0);
    turn->setOffers({});
    const double height = conversation->layOut(400.0);
    EXPECT_TRUE(turn->offers()->hidden());
    EXPECT_EQ(height, 124.0 + measures::kSentenceToCard + measures::kPhoneBottom);
}

TEST_F(KTROffersTest, Ring_StandsBeforeTheQuestionsLastLine) {
    addTurn("", {});
    turn->setProgress(TurnView::Progress::Asking);
    conversation->layOut(400.0);
    const Rect bubble = turn->subviews()[0]->subviews()[1]->frameInRoot();
    const Rect ring = turn->ring()->frameInRoot();
    EXPECT_FALSE(turn->ring()->hidden());
    EXPECT_EQ(ring.maxX(), bubble.x - 12.0);
    EXPECT_EQ(ring.y + ring.height / 2.0, bubble.maxY() - measures::kBubbleBottom - 11.0);
    turn->setProgress(TurnView::Progress::None);
    EXPECT_TRUE(turn->ring()->hidden());
}

TEST_F(KTROffersTest, Patience_GivesWayToTheSentence) {
    addTurn("", {});
    turn->setPatience("Taking longer than usual…");
    conversation->layOut(400.0);
    EXPECT_EQ(turn->sentence(), "");
    turn->setSentence("here");
    turn->setPatience("");
    EXPECT_EQ(turn->sentence(), "here");
}

}  // namespace ktr::host
