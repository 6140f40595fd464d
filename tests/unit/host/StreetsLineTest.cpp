#include "host/conversation/StreetsLine.h"

#include "host/conversation/ConversationView.h"
#include "host/conversation/Measures.h"
#include "platform/host/HeaderItem.h"
#include "platform/ui/Accessibility.h"
#include "tests/support/PatientMaps.h"
#include "tests/support/PlatformTest.h"

namespace ktr::host {

namespace {

using platform::create;
using platform::Rect;

struct Place : platform::MapAnnotation {
    platform::Coordinate coordinate() const override { return {50.21, -3.12}; }
};

/// An answer that is a map and nothing else.
class MapController : public platform::HostSnippetViewController {
  public:
    void loadView() override {
        auto view = create<platform::View>(&platform::View::initWithFrame, Rect{0.0, 0.0, 100.0, 200.0});
        map =
            create<platform::PlatformMapView>(&platform::PlatformMapView::initWithFrame, Rect{0.0, 0.0, 376.0, 200.0});
        map->addAnnotation(place);
        map->setRegion({place->coordinate(), {0.01, 0.01}}, false);
        view->addSubview(map);
        setView(view);
    }
    double desiredHeightForWidth(double) override { return 200.0; }
    std::shared_ptr<platform::HeaderItem> sashItem() override {
        return std::make_shared<platform::HeaderItem>("Friends", nullptr);
    }

    std::shared_ptr<Place> place = std::make_shared<Place>();
    std::shared_ptr<platform::PlatformMapView> map;
};

class KTRStreetsLineTest : public test::PlatformTest {
  protected:
    KTRStreetsLineTest() {
        platform->maps = maps;
        maps->coarseZoom = 9.0;
        localization->set("org.ktr.host", "MAP_NO_STREETS", "No streets here.");
        localization->set("org.ktr.host", "MAP_GET_STREETS", "Get some");
    }
    /// A turn whose map has learnt what there is.
    void addTurn() {
        turn = create<TurnView>(&TurnView::initWithFrame, Rect{});
        turn->setTexts({"Today, 17:42", "17:42", "where is ann", "here"});
        conversation->addTurn(turn);
        answer();
    }
    void answer() {
        controller = create<MapController>(&MapController::init);
        turn->setController(controller);
        conversation->layOut(400.0);
        mapArrives();
    }
    void mapArrives() {
        time->runUntilIdle(1.0);
        maps->answer();
        time->runUntilIdle(1.0);
    }
    bool isOffered() const { return turn->streets() && !turn->streets()->hidden(); }
    std::vector<platform::AccessibilityNode> links() const {
        std::vector<platform::AccessibilityNode> found;
        const auto visit = [&](const auto& self, const platform::AccessibilityNode& node) -> void {
            if (node.role == platform::AccessibilityRole::Link) {
                found.push_back(node);
            }
            for (const auto& child : node.children) {
                self(self, child);
            }
        };
        visit(visit, platform::accessibilityTree(conversation, assistant->rightToLeft));
        return found;
    }

    std::shared_ptr<test::PatientMaps> maps = std::make_shared<test::PatientMaps>();
    std::shared_ptr<ConversationView> conversation = create<ConversationView>(&ConversationView::initWithFrame, Rect{});
    std::shared_ptr<TurnView> turn;
    std::shared_ptr<MapController> controller;
    int asked = 0;
};

}  // namespace

TEST_F(KTRStreetsLineTest, UnderACardWithoutStreets_OneLineOffersThem) {
    conversation->setGetStreets([this] { ++asked; });
    addTurn();
    EXPECT_FALSE(isOffered()) << "laid out before anything was known";
    ASSERT_TRUE(turn->isOutdated());
    const double height = conversation->layOut(400.0);
    ASSERT_TRUE(isOffered());
    EXPECT_FALSE(turn->isOutdated());
    const Rect card = turn->card()->frameInRoot();
    // 2 below the card, 46 high; the action is a target of 44, whose eight letters of 12 end 12 in from the card's.
    EXPECT_EQ(turn->streets()->frameInRoot(), (Rect{card.x, card.maxY() + 2.0, card.width, 46.0}));
    EXPECT_EQ(turn->streets()->subviews()[0]->frameInRoot().x, 27.0);
    EXPECT_EQ(turn->streets()->action()->frameInRoot(), (Rect{388.0 - 120.0, card.maxY() + 3.0, 120.0, 44.0}));
    EXPECT_EQ(height, card.maxY() + 2.0 + 46.0 + measures::kPhoneBottom);
    const auto offered = links();
    ASSERT_EQ(offered.size(), 1u);
    EXPECT_EQ(offered[0].text, "Get some");
    EXPECT_TRUE(platform::accessibilityPress(offered[0]));
    EXPECT_EQ(asked, 1);
}

TEST_F(KTRStreetsLineTest, StreetsThatCome_TakeTheLineAway) {
    conversation->setGetStreets([this] { ++asked; });
    addTurn();
    const double with = conversation->layOut(400.0);
    ASSERT_TRUE(isOffered());
    maps->coarseZoom.reset();
    maps->change();
    mapArrives();
    EXPECT_TRUE(turn->isOutdated());
    EXPECT_EQ(conversation->layOut(400.0), with - 48.0);
    EXPECT_FALSE(isOffered());
    EXPECT_TRUE(links().empty());
}

TEST_F(KTRStreetsLineTest, WhereNothingCanBeDone_NothingIsSaid) {
    addTurn();
    conversation->layOut(400.0);
    EXPECT_EQ(turn->streets(), nullptr);
    conversation->setGetStreets([this] { ++asked; });
    EXPECT_TRUE(turn->isOutdated()) << "a map that had told before is heard";
    conversation->layOut(400.0);
    EXPECT_TRUE(isOffered());
    conversation->setGetStreets(nullptr);
    conversation->layOut(400.0);
    EXPECT_EQ(turn->streets(), nullptr);
    EXPECT_TRUE(links().empty());
}

TEST_F(KTRStreetsLineTest, WithoutAPlace_NoStreetsAreOffered) {
    conversation->setGetStreets([this] { ++asked; });
    addTurn();
    conversation->layOut(400.0);
    ASSERT_TRUE(isOffered());
    controller->map->removeAnnotation(controller->place);
    time->runUntilIdle(1.0);
    ASSERT_TRUE(turn->isOutdated());
    conversation->layOut(400.0);
    EXPECT_FALSE(isOffered());
}

TEST_F(KTRStreetsLineTest, ACardThatIsMadeAnew_SaysItsOwn) {
    conversation->setGetStreets([this] { ++asked; });
    addTurn();
    conversation->layOut(400.0);
    ASSERT_TRUE(isOffered());
    localization->set("org.ktr.host", "MAP_GET_STREETS", "Anderes");
    turn->renew();
    conversation->layOut(400.0);
    EXPECT_FALSE(isOffered()) << "the other card's map is no more";
    answer();
    conversation->layOut(400.0);
    ASSERT_TRUE(isOffered());
    EXPECT_EQ(links().at(0).text, "Anderes");
}

TEST_F(KTRStreetsLineTest, RightToLeft_Mirrors) {
    assistant->rightToLeft = true;
    conversation->setGetStreets([this] { ++asked; });
    addTurn();
    conversation->layOut(400.0);
    ASSERT_TRUE(isOffered());
    EXPECT_EQ(turn->streets()->action()->frameInRoot().x, 12.0);
    EXPECT_EQ(turn->streets()->subviews()[0]->frameInRoot().maxX(), 400.0 - 27.0);
}

TEST_F(KTRStreetsLineTest, Wide_StandsUnderItsCard) {
    conversation->setGetStreets([this] { ++asked; });
    addTurn();
    conversation->layOut(1100.0);
    ASSERT_TRUE(isOffered());
    const Rect card = turn->card()->frameInRoot();
    EXPECT_EQ(turn->streets()->frameInRoot(), (Rect{card.x, card.maxY() + 2.0, card.width, 46.0}));
}

TEST_F(KTRStreetsLineTest, WordsWithTooLittleRoom_StandAboveTheAction) {
    localization->set("org.ktr.host", "MAP_GET_STREETS", "Get them from somewhere");
    conversation->setGetStreets([this] { ++asked; });
    addTurn();
    conversation->layOut(400.0);
    ASSERT_TRUE(isOffered());
    const Rect words = turn->streets()->subviews()[0]->frameInRoot();
    const Rect action = turn->streets()->action()->frameInRoot();
    EXPECT_EQ(action.y, words.maxY());
    EXPECT_EQ(action.x + OfferView::kLineSide, words.x) << "its words begin where theirs do";
    EXPECT_EQ(words.width, 376.0 - 30.0);
    EXPECT_EQ(turn->streets()->frameInRoot().maxY(), action.maxY());
}

}  // namespace ktr::host
