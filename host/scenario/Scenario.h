#pragma once

#include <memory>
#include <optional>
#include <string>
#include <utility>
#include <vector>

#include "documents/IsoTime.h"
#include "linux/positions/ScenarioPositions.h"
#include "platform/assistant/AssistantObject.h"
#include "platform/location/PlatformLocation.h"
#include "platform/ui/Device.h"

namespace ktr::host {

/// A text in one language or in several. A value.
class LocalizedText {
  public:
    LocalizedText() = default;
    explicit LocalizedText(std::string text) { texts_.emplace_back("", std::move(text)); }
    void add(std::string language, std::string text) { texts_.emplace_back(std::move(language), std::move(text)); }
    bool empty() const { return texts_.empty(); }
    /// The text for a language (BCP 47): of that very language, else of the same primary language, else English, else
    /// the first. Empty when there is none at all.
    std::string text(const std::string& language) const;

  private:
    /// In the file's order; the language is empty for a text that has none.
    std::vector<std::pair<std::string, std::string>> texts_;
};

using linux_::ScenarioPosition;

/// An assistant object of a kind that this host does not know: handed on, so that the plugin has the last word.
class UnknownAssistantObject : public platform::AssistantObject {
  public:
    explicit UnknownAssistantObject(std::string kind) : kind_(std::move(kind)) {}
    std::string description() const override { return kind_; }

  private:
    std::string kind_;
};

/// One turn of a conversation and the world around it, as a scenario file tells it (docs/scenario-format.md).
struct Scenario {
    std::string file;  ///< as it was given
    /// Kind and object of the answer; an answer that is a sentence alone has neither.
    std::string kind;
    std::shared_ptr<platform::AssistantObject> snippet;
    LocalizedText question;
    LocalizedText sentence;
    /// Paths of vCard files or folders, relative ones resolved against the scenario's folder.
    std::vector<std::string> contacts;
    std::optional<std::string> language;  ///< BCP 47
    std::optional<std::string> region;    ///< BCP 47
    std::optional<std::string> country;   ///< of the phone numbers; two letters in upper case
    std::optional<platform::ContentSizeCategory> textSize;
    std::optional<platform::UserInterfaceIdiom> idiom;
    std::optional<documents::IsoTime> clock;  ///< the moment at which the scenario starts
    std::vector<ScenarioPosition> positions;
    std::optional<bool> dark;
    /// Of the user's own account: an e-mail address or a phone number; null: not signed in.
    std::optional<std::string> userName;
};

/// Whether a text has the form of a language tag (BCP 47): letters and digits in groups of up to eight, joined by "-".
bool isLanguageTag(const std::string& text);

}  // namespace ktr::host
