#include "app/window/settings/SettingsPage.h"

#include <QDir>
#include <QDragEnterEvent>
#include <QDropEvent>
#include <QFileDialog>
#include <QLocale>
#include <QMimeData>
#include <QTimer>
#include <QUrl>
#include <algorithm>
#include <array>
#include <atomic>
#include <utility>

#include "app/window/settings/ChoicePage.h"
#include "app/window/settings/MapPage.h"
#include "host/Resources.h"
#include "host/links/KnownFriends.h"
#include "linux/configuration/SignOut.h"
#include "linux/device/LinuxDevice.h"
#include "platform/base/Format.h"
#include "platform/contacts/MonogramMaker.h"

namespace ktr::app {

namespace {

using platform::ContentSizeCategory;
using platform::Value;

constexpr int kTextStart = 27;
constexpr int kAboveSection = 20;
constexpr int kBelowSection = 8;
constexpr int kBelowAll = 24;
constexpr double kFace = 54.0;

constexpr std::array kSizeKeys = {"SIZE_XS", "SIZE_S", "SIZE_M", "SIZE_L", "SIZE_XL", "SIZE_XXL", "SIZE_XXXL"};
constexpr std::array kSizeNames = {"XS", "S", "M", "L", "XL", "XXL", "XXXL", "AX1", "AX2", "AX3", "AX4", "AX5"};
constexpr std::array kColorKeys = {"SETTINGS_AS_SYSTEM", "COLORS_LIGHT", "COLORS_DARK", "COLORS_HIGH"};
constexpr std::array kColorNames = {"system", "light", "dark", "high-contrast"};
constexpr std::array kDistanceKeys = {"SETTINGS_AS_SYSTEM", "DISTANCES_METRIC", "DISTANCES_MILES"};
constexpr std::array kDistanceNames = {"system", "kilometres", "miles"};

}  // namespace

SettingsPage::SettingsPage(host::Host& host, SharingRow::Wish wish, Window window)
    : ColumnPage(Bar::With),
      host_(host),
      window_(std::move(window)),
      shown_(host.live()->configuration()),
      account_(new AccountRow),
      sharing_(new SharingRow(host, std::move(wish))),
      textSize_(new StepRow),
      watch_(qEnvironmentVariable("DBUS_SESSION_BUS_ADDRESS"), QStringLiteral("ktr-watch.service")),
      desk_(host.settings().liveConfiguration.value_or("")),
      aside_(owner_) {
    setAcceptDrops(true);
    auto* account = new ListCard;
    account->add(account_);
    column().add(account, {0});
    account_->signOut().setPressed([this] { signOut(); });

    auto* sharing = addSection("SETTINGS_SHARING");
    sharing->add(sharing_);
    sharing_->setHeard([this] {
        whoSees_->setVisible(sharing_->isKnown());
        keepMapsSeen();
    });
    whoSees_ = addRow(sharing, ListRow::Kind::Leads, [this] {
        if (const auto& who = shown_.account; who && who->host) {
            window_.openLink("https://" + *who->host + "/me");
        }
    });
    whoSees_->hide();

    auto* reading = addSection("SETTINGS_READING");
    reading->add(textSize_);
    textSize_->setStepped([this](int by) { stepTextSize(by); });
    colors_ = addRow(reading, ListRow::Kind::Leads, [this] { chooseColors(); });
    distances_ = addRow(reading, ListRow::Kind::Leads, [this] { chooseDistances(); });
    language_ = addRow(reading, ListRow::Kind::Leads, [this] { chooseLanguage(); });

    notices_ = addRow(reading, ListRow::Kind::Switch, [this] {
        watch_.setOn(!notices_->isChecked());
        showNotices();
    });
    watch_.setChanged([this] { showNotices(); });

    auto* contacts = addSection("SETTINGS_CONTACTS");
    books_ = addRow(contacts, ListRow::Kind::Switch, [this] {
        shown_.addressBooks = !shown_.addressBooks;
        change("addressBooks", shown_.addressBooks ? std::nullopt : std::optional(Value(false)));
    });
    position_ = addRow(contacts, ListRow::Kind::Switch, [this] {
        using Source = Configuration::Positions::Source;
        const bool isOn = shown_.positions.source != Source::None;
        shown_.positions.source = isOn ? Source::None : Source::GeoClue;
        change("positions.source", isOn ? std::optional(Value("none")) : std::nullopt);
    });

    maps_ = addSection("SETTINGS_MAPS");
    showMaps({});
    checkUp_ = addRow(addSection("SETTINGS_HELP"), ListRow::Kind::Leads, [this] { window_.showCheckUp(); });
    column().setMargins(0, kBelowAll);
    listMaps();
}

ListCard* SettingsPage::addSection(const char* key) {
    auto* name = new Words(BlockStyle::Subheadline, Words::Tone::Soft);
    auto* card = new ListCard;
    column().add(name, {kAboveSection, kTextStart, kTextStart});
    column().add(card, {kBelowSection});
    sections_.push_back({name, key});
    return card;
}

ListRow* SettingsPage::addRow(ListCard* card, ListRow::Kind kind, std::function<void()> pressed) {
    auto* row = new ListRow(kind);
    row->setPressed(std::move(pressed));
    card->add(row);
    return row;
}

QString SettingsPage::text(const char* key) const {
    return QString::fromStdString(host_.text(key));
}

QString SettingsPage::name() const {
    return text("SETTINGS");
}

QWidget* SettingsPage::firstFocus() const {
    return window_.beginsAtMaps ? addMap_ : ColumnPage::firstFocus();
}

void SettingsPage::keepMapsSeen() {
    // Once everything has its new place.
    QTimer::singleShot(0, this, [this] {
        if (addMap_->hasFocus()) {
            reveal(*maps_);
        }
    });
}

void SettingsPage::refreshed() {
    if (!desk_.isBusy()) {
        shown_ = host_.live()->configuration();
    }
    setTexts();
    setValues();
    ColumnPage::refreshed();
    if (!std::exchange(hasAsked_, true)) {
        sharing_->ask();
    }
}

void SettingsPage::setTexts() {
    bar()->setTexts(name(), text("PAGE_BACK"));
    for (const Section& section : sections_) {
        section.name->setText(text(section.key));
    }
    whoSees_->setWords(text("SETTINGS_WHO"));
    textSize_->setTexts({text("SETTINGS_TEXT_SIZE"), text("SETTINGS_SMALLER"), text("SETTINGS_LARGER")});
    colors_->setWords(text("SETTINGS_COLORS"));
    distances_->setWords(text("SETTINGS_DISTANCES"));
    language_->setWords(text("SETTINGS_LANGUAGE"));
    notices_->setWords(text("SETTINGS_WATCH"));
    showNotices();
    books_->setWords(text("SETTINGS_BOOKS"));
    books_->setSecond(text("SETTINGS_BOOKS_LINE"));
    position_->setWords(text("SETTINGS_POSITION"));
    position_->setSecond(text("SETTINGS_POSITION_LINE"));
    checkUp_->setWords(text("CHECK_UP"));
    showMaps(listed_);
}

QString SettingsPage::sizeWords() const {
    const auto size = static_cast<std::size_t>(host_.settings().textSize);
    if (size < kSizeKeys.size()) {
        return text(kSizeKeys[size]);
    }
    const auto step = static_cast<std::int64_t>(size - kSizeKeys.size() + 1);
    return QString::fromStdString(
        platform::formatted(host_.text("SIZE_AX"), {platform::FormatArgument(host_.number(step))}));
}

QString SettingsPage::languageWords(const std::string& language) const {
    const QString own = QLocale(QString::fromStdString(language)).nativeLanguageName();
    return own.isEmpty() ? QString::fromStdString(language) : own.left(1).toUpper() + own.mid(1);
}

void SettingsPage::setValues() {
    const auto& account = shown_.account;
    const std::string person = account ? account->personId : "";
    const std::string handle = person.find('@') != std::string::npos ? person : "";
    const auto known = host::KnownFriends::named(account ? account->userName.value_or(person) : "", handle);
    account_->setTexts(QString::fromStdString(host::KnownFriends::nameOf(*known.location)),
                       QString::fromStdString(account ? account->host.value_or("") : ""), text("SETTINGS_SIGN_OUT"));
    const auto& faces = host_.platform()->avatarImages;
    account_->setFace(std::dynamic_pointer_cast<const linux_::QtImage>(
        faces ? faces->avatarForContact(host::KnownFriends::contactOf(*known.location), kFace) : nullptr));

    const auto& said = host_.settings().said;
    const auto held = [this](ListRow& row, bool isHeld) {
        row.setHeld(isHeld);
        row.setSecond(isHeld ? text("SETTINGS_SET_FOR_YOU") : QString());
    };
    const auto size = host_.settings().textSize;
    textSize_->setValue(sizeWords());
    textSize_->setEnds(!window_.isTextSizeHeld && size > ContentSizeCategory::XS,
                       !window_.isTextSizeHeld && size < ContentSizeCategory::AX5);
    colors_->setValue(text(kColorKeys[static_cast<std::size_t>(shown_.colors)]));
    held(*colors_, said.dark || said.highContrast);
    distances_->setValue(text(kDistanceKeys[static_cast<std::size_t>(shown_.distances)]));
    language_->setValue(shown_.language ? languageWords(*shown_.language) : text("SETTINGS_AS_SYSTEM"));
    held(*language_, said.language.has_value());
    books_->setChecked(shown_.addressBooks);
    position_->setChecked(shown_.positions.source != Configuration::Positions::Source::None);
}

void SettingsPage::showNotices() {
    using State = linux_::UserUnit::State;
    const State state = watch_.state();
    notices_->setChecked(state == State::On);
    notices_->setHeld(watch_.isBusy() || (state != State::On && state != State::Off));
    notices_->setSecond(text(state == State::None ? "SETTINGS_WATCH_NONE" : "SETTINGS_WATCH_LINE"));
}

void SettingsPage::change(const std::string& name, std::optional<Value> value) {
    keep(name, std::move(value), nullptr);
}

void SettingsPage::keep(const std::string& name, std::optional<Value> value, std::function<void()> undo) {
    setValues();
    desk_.change({{name, std::move(value)}}, [this, undo = std::move(undo)](const std::string& problem) {
        if (!problem.empty()) {
            shown_ = host_.live()->configuration();
            if (undo) {
                undo();
            }
            setValues();
            window_.say(host_.text("SIGN_IN_NOT_WRITTEN"));
        }
    });
}

void SettingsPage::stepTextSize(int by) {
    const ContentSizeCategory before = host_.settings().textSize;
    const int size = std::clamp(static_cast<int>(before) + by, 0, static_cast<int>(ContentSizeCategory::AX5));
    // The window has it at once; the file is for the next one.
    window_.setTextSize(static_cast<ContentSizeCategory>(size));
    keep("textSize", Value(kSizeNames[static_cast<std::size_t>(size)]),
         [this, before] { window_.setTextSize(before); });
}

void SettingsPage::chooseColors() {
    const auto offer = [this] {
        std::vector<ChoicePage::Choice> choices;
        choices.reserve(kColorKeys.size());
        for (const char* key : kColorKeys) {
            choices.push_back({text(key)});
        }
        return choices;
    };
    window_.open(std::make_unique<ChoicePage>(
        host_, "SETTINGS_COLORS", offer, static_cast<int>(shown_.colors), [this](int chosen) {
            shown_.colors = static_cast<Configuration::Colors>(chosen);
            change("colors",
                   chosen == 0 ? std::nullopt : std::optional(Value(kColorNames[static_cast<std::size_t>(chosen)])));
        }));
}

void SettingsPage::chooseDistances() {
    const auto offer = [this] {
        std::vector<ChoicePage::Choice> choices;
        choices.reserve(kDistanceKeys.size());
        for (const char* key : kDistanceKeys) {
            choices.push_back({text(key)});
        }
        return choices;
    };
    window_.open(std::make_unique<ChoicePage>(
        host_, "SETTINGS_DISTANCES", offer, static_cast<int>(shown_.distances), [this](int chosen) {
            shown_.distances = static_cast<Configuration::Distances>(chosen);
            change("distances",
                   chosen == 0 ? std::nullopt : std::optional(Value(kDistanceNames[static_cast<std::size_t>(chosen)])));
        }));
}

std::vector<std::string> SettingsPage::languages() {
    constexpr const char* kPrefix = "host_";
    const QDir folder(QString::fromStdString((host::resourceFolder() / "localization").string()));
    std::vector<std::string> languages;
    for (const QString& file : folder.entryList({QLatin1String(kPrefix) + QStringLiteral("*.qm")}, QDir::Files)) {
        const QString language = QFileInfo(file).completeBaseName().mid(static_cast<int>(qstrlen(kPrefix)));
        // One that is made up for tests has no name of its own.
        if (QLocale(language).language() != QLocale::C) {
            languages.push_back(language.toStdString());
        }
    }
    return languages;
}

void SettingsPage::chooseLanguage() {
    const auto all = languages();
    const auto offer = [this, all] {
        std::vector<ChoicePage::Choice> choices = {{text("SETTINGS_AS_SYSTEM")}};
        for (const std::string& language : all) {
            choices.push_back({languageWords(language)});
        }
        return choices;
    };
    const auto at = shown_.language ? std::find(all.begin(), all.end(), *shown_.language) : all.end();
    const int chosen = at == all.end() ? 0 : static_cast<int>(at - all.begin()) + 1;
    window_.open(std::make_unique<ChoicePage>(host_, "SETTINGS_LANGUAGE", offer, chosen, [this, all](int choice) {
        shown_.language = choice == 0 ? std::nullopt : std::optional(all[static_cast<std::size_t>(choice - 1)]);
        change("language", shown_.language ? std::optional(Value(*shown_.language)) : std::nullopt);
    }));
}

void SettingsPage::signOut() {
    account_->signOut().setBusy(true);
    aside_.run([this, file = host_.settings().liveConfiguration.value_or("")]() -> linux_::Aside::Then {
        const std::atomic<bool> givesUp = false;
        return [this, problem = linux_::SignOut::run(file, givesUp)] {
            account_->signOut().setBusy(false);
            if (!problem.empty()) {
                window_.say(host_.text("SIGN_IN_NOT_WRITTEN"));
            }
            // The window asks for an account once it finds none.
            host_.live()->readAgain();
        };
    });
}

void SettingsPage::listMaps() {
    aside_.run([this]() -> linux_::Aside::Then { return [this, maps = AddedMaps::list()] { showMaps(maps); }; });
}

void SettingsPage::showMaps(const std::vector<AddedMaps::Map>& maps) {
    // What has the focus stays: rows are made anew where there are others.
    const auto isSame = [](const AddedMaps::Map& one, const AddedMaps::Map& other) {
        return one.place == other.place && one.name == other.name && one.bytes == other.bytes;
    };
    if (addMap_ == nullptr || !std::equal(maps.begin(), maps.end(), listed_.begin(), listed_.end(), isSame)) {
        listed_ = maps;
        const bool hadFocus = addMap_ != nullptr && addMap_->hasFocus();
        maps_->clear();
        for (const AddedMaps::Map& map : listed_) {
            auto* row = new ListRow(ListRow::Kind::Leads, QString::fromStdString(map.name));
            row->setPressed([this, map] { showMap(map); });
            maps_->add(row);
        }
        world_ = new ListRow(ListRow::Kind::Plain);
        maps_->add(world_);
        addMap_ = addRow(maps_, ListRow::Kind::Adds, [this] { chooseMap(); });
        if (hadFocus) {
            addMap_->setFocus(Qt::OtherFocusReason);
            keepMapsSeen();
        }
    }
    for (std::size_t i = 0; i < listed_.size(); ++i) {
        static_cast<ListRow*>(maps_->rows()[i])->setSecond(sizeOf(listed_[i]));
    }
    world_->setWords(text("MAPS_WORLD"));
    world_->setSecond(text("MAPS_WORLD_LINE"));
    addMap_->setWords(text("MAPS_ADD"));
}

QString SettingsPage::sizeOf(const AddedMaps::Map& map) const {
    if (map.bytes == 0) {
        return text("CHECK_FILE_LINE");
    }
    const QLocale locale(QString::fromStdString(host_.settings().language));
    const QString size = locale.formattedDataSize(static_cast<qint64>(map.bytes), 0, QLocale::DataSizeSIFormat);
    return QString::fromStdString(
        platform::formatted(host_.text("MAPS_STREETS"), {platform::FormatArgument(size.toStdString())}));
}

void SettingsPage::showMap(const AddedMaps::Map& map) {
    window_.open(std::make_unique<MapPage>(host_, QString::fromStdString(map.name), sizeOf(map), [this, map] {
        aside_.run([this, map]() -> linux_::Aside::Then {
            return [this, problem = AddedMaps::remove(map.place)] {
                if (problem.empty()) {
                    window_.back();
                } else {
                    window_.say(host_.text("SIGN_IN_NOT_WRITTEN"));
                }
                listMaps();
            };
        });
    }));
}

void SettingsPage::chooseMap() {
    auto* dialog = new QFileDialog(this, text("MAPS_ADD"), QDir::homePath(), QStringLiteral("*.mbtiles"));
    dialog->setAttribute(Qt::WA_DeleteOnClose);
    dialog->setFileMode(QFileDialog::ExistingFile);
    connect(dialog, &QFileDialog::fileSelected, this, [this](const QString& file) { addMap(file); });
    dialog->open();
}

void SettingsPage::addMap(const QString& file) {
    addMap_->setHeld(true);
    aside_.run([this, file = file.toStdString()]() -> linux_::Aside::Then {
        return [this, added = AddedMaps::add(file)] {
            addMap_->setHeld(false);
            if (std::holds_alternative<AddedMaps::Problem>(added)) {
                window_.say(host_.text("MAPS_REFUSED"));
            }
            listMaps();
        };
    });
}

void SettingsPage::dragEnterEvent(QDragEnterEvent* event) {
    const auto urls = event->mimeData()->urls();
    if (std::any_of(urls.begin(), urls.end(), [](const QUrl& url) { return url.isLocalFile(); })) {
        event->acceptProposedAction();
    }
}

void SettingsPage::dropEvent(QDropEvent* event) {
    for (const QUrl& url : event->mimeData()->urls()) {
        if (url.isLocalFile()) {
            addMap(url.toLocalFile());
        }
    }
    event->acceptProposedAction();
}

}  // namespace ktr::app
