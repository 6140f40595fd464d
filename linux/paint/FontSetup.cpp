#include "linux/paint/FontSetup.h"

#include <QByteArray>
#include <QDir>
#include <QFile>
#include <QFontDatabase>
#include <QTemporaryFile>
#include <QtGlobal>
#include <array>
#include <cstdio>

#include "documents/Words.h"

namespace ktr::linux_ {

namespace {

constexpr const char* kTrueType = "/usr/share/fonts/truetype/noto/";
constexpr const char* kOpenType = "/usr/share/fonts/opentype/noto/";

/// Noto Sans and its scripts, each in Regular and Bold.
constexpr std::array kPairs = {"NotoSans",         "NotoSansArabic",     "NotoSansHebrew",   "NotoSansArmenian",
                               "NotoSansGeorgian", "NotoSansDevanagari", "NotoSansBengali",  "NotoSansGurmukhi",
                               "NotoSansGujarati", "NotoSansOriya",      "NotoSansTamil",    "NotoSansTelugu",
                               "NotoSansKannada",  "NotoSansMalayalam",  "NotoSansSinhala",  "NotoSansThai",
                               "NotoSansLao",      "NotoSansMyanmar",    "NotoSansEthiopic", "NotoSansKhmer",
                               "NotoSansThaana",   "NotoSerifTibetan",   "NotoSansSymbols",  "NotoSansCherokee"};
/// Those that come in Regular only.
constexpr std::array kSingles = {"NotoSansSyriac", "NotoSansMongolian", "NotoSansSymbols2", "NotoSansMath"};

QtMessageHandler previousHandler = nullptr;

/// Noto Sans leaves most scripts to fonts of their own. Qt says so for each script, and that is no news; there is no
/// category to switch it off by.
void passOn(QtMsgType type, const QMessageLogContext& context, const QString& text) {
    if (text.contains(QLatin1String("OpenType support missing"))) {
        return;
    }
    if (previousHandler != nullptr) {
        previousHandler(type, context, text);
    } else {
        std::fprintf(stderr, "%s\n", documents::forLine(qFormatLogMessage(type, context, text).toStdString()).c_str());
    }
}

QString file(const char* folder, const char* name, const char* ending) {
    return QString::fromLatin1(folder) + QString::fromLatin1(name) + QString::fromLatin1(ending);
}

/// A configuration that lists no folders, so that fontconfig finds no font at all, in a file of the process's own.
/// (From an unreadable or empty file fontconfig falls back to its built-in folders; what is no real file it does not
/// open.)
class EmptyConfiguration {
  public:
    EmptyConfiguration() {
        file_.setFileTemplate(QDir::tempPath() + QStringLiteral("/ktr-fonts-XXXXXX.conf"));
        written_ = file_.open() && file_.write("<?xml version=\"1.0\"?><fontconfig></fontconfig>") > 0 && file_.flush();
    }
    /// Empty when it could not be written.
    QByteArray name() const { return written_ ? QFile::encodeName(file_.fileName()) : QByteArray(); }

  private:
    QTemporaryFile file_;  // removed with the object
    bool written_ = false;
};

}  // namespace

bool FontSetup::prepare(Mode mode, std::string* error) {
    // An emboldened or slanted face is none of the design's; where a weight is missing, Regular serves.
    bool done = qputenv("QT_NO_SYNTHESIZED_BOLD", "1") && qputenv("QT_NO_SYNTHESIZED_ITALIC", "1");
    if (mode == Mode::Pinned) {
        static const EmptyConfiguration kEmpty;
        const QByteArray file = kEmpty.name();
        done = done && !file.isEmpty() && qputenv("FONTCONFIG_FILE", file);
    }
    if (!done && error != nullptr) {
        *error = "the environment for the fonts cannot be set";
    }
    static const bool kQuiet = [] {
        previousHandler = qInstallMessageHandler(passOn);
        return true;
    }();
    static_cast<void>(kQuiet);
    return done;
}

QStringList FontSetup::pinnedFiles() {
    QStringList files;
    for (const char* name : kPairs) {
        files << file(kTrueType, name, "-Regular.ttf") << file(kTrueType, name, "-Bold.ttf");
    }
    for (const char* name : kSingles) {
        files << file(kTrueType, name, "-Regular.ttf");
    }
    files << file(kOpenType, "NotoSansCJK", "-Regular.ttc") << file(kOpenType, "NotoSansCJK", "-Bold.ttc");
    files << file(kTrueType, "NotoColorEmoji", ".ttf");
    return files;
}

std::vector<std::string> FontSetup::load(Mode mode) {
    std::vector<std::string> missing;
    if (mode == Mode::System) {
        return missing;
    }
    for (const QString& name : pinnedFiles()) {
        if (!QFile::exists(name) || QFontDatabase::addApplicationFont(name) < 0) {
            missing.push_back(name.toStdString());
        }
    }
    return missing;
}

}  // namespace ktr::linux_
