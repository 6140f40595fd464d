#pragma once

#include <QString>
#include <QStringList>
#include <string>
#include <vector>

namespace ktr::linux_ {

/// Which font files texts are set from: those of the system, or a pinned list that gives the same pixels on every
/// machine that has the packages fonts-noto-core, fonts-noto-cjk and fonts-noto-color-emoji. Main thread.
class FontSetup {
  public:
    enum class Mode { System, Pinned };

    /// Before the QGuiApplication is made: weights and slants are never synthesised; in pinned mode the system's fonts
    /// are hidden. False, with a reason in `error`, when that cannot be set up.
    static bool prepare(Mode mode, std::string* error = nullptr);

    /// After the QGuiApplication is made and before any text is set: loads the pinned files. Gives what is missing
    /// (full names of files; pinned mode only).
    static std::vector<std::string> load(Mode mode);

    /// The files that pinned mode loads, in order.
    static QStringList pinnedFiles();
};

}  // namespace ktr::linux_
