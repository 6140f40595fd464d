#pragma once

#include <QFont>
#include <QString>
#include <QStringList>

#include "platform/ui/Font.h"

namespace ktr::linux_ {

/// Which fonts a text is set in. Any thread, while a QGuiApplication exists.
class FontChoice {
  public:
    /// `language` (BCP 47) decides the forms of Han characters where the text itself leaves them open.
    explicit FontChoice(QString language = {}) : language_(std::move(language)) {}

    /// Noto Sans, then the families of the scripts that occur in the text, then the emoji font, then symbols. The list
    /// holds only what the text can use: each further family would be opened for every character that is missing in the
    /// ones before it.
    QStringList families(QStringView text) const;

    /// The font for a text at a whole size in pixels; regular, bold, and light or thin where they are installed.
    QFont font(const platform::Font& font, int pixelSize, QStringView text) const;

    /// Whether the family has this style ("Light", "Thin", "Bold") as a font of its own.
    static bool hasStyle(const QString& family, const QString& style);
    static const QString& baseFamily();
    static const QString& emojiFamily();

  private:
    QString hanFamily(bool kana, bool hangul) const;

    QString language_;
};

}  // namespace ktr::linux_
