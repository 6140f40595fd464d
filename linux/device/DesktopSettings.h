#pragma once

#include <QColor>
#include <QDBusConnection>
#include <QDBusVariant>
#include <QObject>
#include <QString>
#include <filesystem>
#include <functional>
#include <map>
#include <optional>
#include <utility>

#include "linux/device/Aside.h"
#include "linux/device/FileWatch.h"

namespace ktr::linux_ {

/// What the desktop's user has set for all programs: the size of texts, dark or light, high contrast, less motion and
/// an accent colour. The text size is KDE's, or else that of GNOME and Phosh, and each is asked for only on its own
/// desktop: elsewhere its answer is a stale one. Colours, contrast, motion and accent are those of the desktop portal
/// (org.freedesktop.portal.Settings). Nothing waits: the bus is joined and files are read in the background, and values
/// are none until somebody has said them, for good where nobody does. Main thread.
class DesktopSettings : public QObject {
    Q_OBJECT

  public:
    struct Values {
        std::optional<double> textScale;  ///< 1 is the desktop's usual size
        std::optional<bool> dark;         ///< none: no preference
        std::optional<bool> highContrast;
        std::optional<bool> reducedMotion;
        std::optional<QColor> accent = {};  ///< as the user chose it, whatever stands out from what
        bool operator==(const Values&) const = default;
    };
    /// Where everything is found; a test has its own.
    struct Places {
        QString desktop;                      ///< as XDG_CURRENT_DESKTOP says: names with colons between them
        std::filesystem::path configuration;  ///< the folder of the user's configuration files
        QString busAddress;                   ///< of the session's bus; empty: none
        QString gsettings;                    ///< the program that is asked where no portal answers
        static Places ofSession();
    };

    explicit DesktopSettings(Places places);
    ~DesktopSettings() override;

    const Values& values() const { return values_; }
    /// Called after a value has become another one.
    void setChanged(std::function<void()> changed) { changed_ = std::move(changed); }
    /// The program's windows are used again: what may have changed without a word is asked for anew.
    void refresh();

  private Q_SLOTS:
    void settingChanged(const QString& group, const QString& key, const QDBusVariant& value);

  private:
    enum class Desktop { Kde, Gnome, Other };

    void joinBus();
    void useBus(const QDBusConnection& bus);
    void ask(const QString& group, const QString& key);
    void askAll();
    void take(const QString& group, const QString& key, const QVariant& value);
    void followKdeFonts();
    void readKdeFonts();
    void askGsettings();
    void set(const Values& values);

    const Places places_;
    const Desktop desktop_;
    Values values_;
    std::function<void()> changed_;
    std::optional<QDBusConnection> bus_;
    FileWatch files_;
    bool portalKnowsTextScale_ = false;
    /// Changes that were announced, by group and key of what is asked for: an answer that one of them overtook is
    /// older.
    std::map<std::pair<QString, QString>, unsigned> heard_;
    Aside aside_;
};

}  // namespace ktr::linux_
