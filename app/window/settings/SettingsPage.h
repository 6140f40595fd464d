#pragma once

#include <functional>
#include <memory>
#include <optional>
#include <string>
#include <vector>

#include "app/AddedMaps.h"
#include "app/window/blocks/ListCard.h"
#include "app/window/blocks/StepRow.h"
#include "app/window/friend/SharingRow.h"
#include "app/window/pages/ColumnPage.h"
#include "app/window/settings/AccountRow.h"
#include "app/window/settings/SettingsDesk.h"
#include "host/Host.h"
#include "linux/device/UserUnit.h"

namespace ktr::app {

/// What a person may decide: everything acts at once, and what cannot be kept goes back and is said. Of a window that
/// is live. Main thread.
class SettingsPage : public ColumnPage {
  public:
    /// What the page leaves to its window. None of it is empty.
    struct Window {
        std::function<void(std::unique_ptr<Page>)> open;
        std::function<void()> back;  ///< leaves the newest page
        std::function<void()> showCheckUp;
        std::function<void(const std::string& url)> openLink;
        std::function<void(const std::string& sentence)> say;
        /// Sets it in this window at once.
        std::function<void(platform::ContentSizeCategory)> setTextSize;
        bool isTextSizeHeld = false;  ///< the command line has said it
        bool beginsAtMaps = false;    ///< where a map is added
    };

    /// The host outlives the page.
    SettingsPage(host::Host& host, SharingRow::Wish wish, Window window);

    QString name() const override;
    QWidget* firstFocus() const override;

    AccountRow& account() const { return *account_; }
    SharingRow& sharing() const { return *sharing_; }
    ListRow& whoSees() const { return *whoSees_; }
    StepRow& textSize() const { return *textSize_; }
    ListRow& chosenColors() const { return *colors_; }
    ListRow& distances() const { return *distances_; }
    ListRow& language() const { return *language_; }
    /// Whether the user's services keep what shows notifications.
    ListRow& notices() const { return *notices_; }
    ListRow& books() const { return *books_; }
    ListRow& position() const { return *position_; }
    ListCard& maps() const { return *maps_; }
    ListRow& checkUp() const { return *checkUp_; }
    /// Adds a map, as choosing its file does.
    void addMap(const QString& file);

  protected:
    void refreshed() override;
    void dragEnterEvent(QDragEnterEvent* event) override;
    void dropEvent(QDropEvent* event) override;

  private:
    using Configuration = linux_::Configuration;

    QString text(const char* key) const;
    /// A section's name and its card.
    ListCard* addSection(const char* key);
    ListRow* addRow(ListCard* card, ListRow::Kind kind, std::function<void()> pressed);
    void setTexts();
    void setValues();
    void showNotices();
    QString sizeWords() const;
    static std::vector<std::string> languages();
    QString languageWords(const std::string& language) const;
    /// Writes one setting; with none it goes. `shown_` says already what it will be. `keep` does something besides
    /// where that fails.
    void change(const std::string& name, std::optional<platform::Value> value);
    void keep(const std::string& name, std::optional<platform::Value> value, std::function<void()> undo);
    void stepTextSize(int by);
    void chooseColors();
    void chooseDistances();
    void chooseLanguage();
    void signOut();
    /// What appears above pushes a map that is being added out of sight.
    void keepMapsSeen();
    void listMaps();
    void showMaps(const std::vector<AddedMaps::Map>& maps);
    void showMap(const AddedMaps::Map& map);
    QString sizeOf(const AddedMaps::Map& map) const;
    void chooseMap();

    host::Host& host_;
    const Window window_;
    /// What the configuration says, or will have said once all wishes are written.
    Configuration shown_;
    struct Section {
        Words* name;
        const char* key;
    };
    std::vector<Section> sections_;
    AccountRow* account_;
    SharingRow* sharing_;
    ListRow* whoSees_;
    StepRow* textSize_;
    ListRow* colors_;
    ListRow* distances_;
    ListRow* language_;
    ListRow* notices_;
    ListRow* books_;
    ListRow* position_;
    ListCard* maps_;
    std::vector<AddedMaps::Map> listed_;
    ListRow* world_ = nullptr;
    ListRow* addMap_ = nullptr;
    ListRow* checkUp_;
    bool hasAsked_ = false;
    linux_::UserUnit watch_;
    QObject owner_;
    SettingsDesk desk_;
    linux_::Aside aside_;
};

}  // namespace ktr::app
