#include <gtest/gtest.h>

#include <memory>
#include <optional>
#include <string>
#include <vector>

#include "host/Host.h"
#include "host/HostOptions.h"
#include "host/conversation/BubbleView.h"
#include "host/scenario/ScenarioReader.h"
#include "platform/assistant/VAKtrGeoFence.h"
#include "platform/assistant/VASnippet.h"
#include "platform/ui/Label.h"

namespace ktr::test {

using host::Host;
using platform::Label;

namespace {

constexpr const char* kLanguages[] = {"en", "ar", "de", "el", "es", "fa", "fr", "he", "hi",      "it",     "ja",
                                      "ko", "nl", "pl", "pt", "ru", "sv", "tr", "uk", "zh-Hans", "zh-Hant"};
/// Places that every language has a word for; null: none.
constexpr const char* kPlaces[] = {"_$!<home>!$_", "_$!<work>!$_", "_$!<school>!$_", "_$!<gym>!$_", nullptr};

void collect(const std::shared_ptr<platform::View>& view, std::vector<std::shared_ptr<Label>>& labels) {
    if (const auto label = std::dynamic_pointer_cast<Label>(view)) {
        labels.push_back(label);
    }
    for (const auto& subview : view->presentedSubviews()) {
        collect(subview, labels);
    }
}

}  // namespace

/// What a fence promises, with the real plugin, texts and fonts.
class FenceWordsTest : public ::testing::Test {
  protected:
    /// The row's labels in the narrowest window at the largest size that has rows.
    std::vector<std::shared_ptr<Label>> labels(const std::string& language, const char* trigger, const char* place) {
        host = nullptr;
        auto read = host::ScenarioReader({0.0}).readFile(KTR_SOURCE_DIR "/resources/scenarios/fence-leaving.json");
        auto scenario = std::get<host::Scenario>(read);
        const auto snippet = std::dynamic_pointer_cast<platform::VAKtrGeoFenceSnippet>(scenario.snippet);
        snippet->cueKtrGeoFence->geoFenceTrigger = trigger;
        snippet->cueKtrGeoFence->location->label = place != nullptr ? std::optional<std::string>(place) : std::nullopt;
        host::HostOptions options;
        options.language = language;
        options.textSize = platform::ContentSizeCategory::XL;
        options.width = 320.0;
        auto decided = host::HostSettings::decide(options, {scenario}, {{790171200.0}, 0});
        auto made = Host::make(std::get<host::HostSettings>(decided), Host::Time::Virtual, KTR_PLUGIN_FILE);
        host = std::move(std::get<std::unique_ptr<Host>>(made));
        EXPECT_FALSE(host->addTurn(scenario));
        host->settle(320.0);
        std::vector<std::shared_ptr<Label>> found;
        collect(host->conversation()->turns().back()->card()->content(), found);
        return found;
    }
    std::unique_ptr<Host> host;
};

TEST_F(FenceWordsTest, PromisesOfUsualPlaces_FitTheirOneLineInEveryLanguage) {
    for (const char* language : kLanguages) {
        for (const char* trigger : {"OnArrival", "OnDeparture", "Immediate"}) {
            for (const char* place : kPlaces) {
                const auto found = labels(language, trigger, place);
                ASSERT_EQ(found.size(), 2U) << "the name and the promise";
                for (const auto& label : found) {
                    EXPECT_EQ(label->numberOfLines(), 1);
                    EXPECT_LE(host::wrappedSize(label->text(), label->font(), 1e6).size.width,
                              label->frame().width + 0.01)
                        << language << ": " << label->text();
                }
            }
        }
    }
}

}  // namespace ktr::test
