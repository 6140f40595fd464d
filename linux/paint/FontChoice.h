#pragma once

#include <QFont>
#include <QString>
#include <QStringList>
#include <QTextFormat>
#include <vector>

#include "platform/ui/Font.h"

namespace ktr::linux_ {

/// A font as it can be made in any thread: a QFont keeps what the thread that used it has loaded.
struct FontSpec {
    QString family;
    int pixelSize = 16;
    QFont::Weight weight = QFont::Normal;

    bool operator==(const FontSpec&) const = default;
    /// The family, the base family behind it, then the emoji font, then symbols. Qt keeps this list for all fonts that
    /// begin with the same family, so that it must not depend on anything else.
    const QFont& font() const { return made().font; }
    /// The same as a format for a part of a text. Both are valid until the next call, in this thread.
    const QTextCharFormat& format() const { return made().format; }

  private:
    struct Made {
        QFont font;
        QTextCharFormat format;
    };
    static constexpr std::size_t kMostKept = 64;
    const Made& made() const;
    QFont make() const;
};

/// Which fonts a text is set in: Noto Sans, and for what has a script of its own the Noto font of that script. Any
/// thread, while a QGuiApplication exists.
class FontChoice {
  public:
    /// A stretch of a text in one family.
    struct Stretch {
        qsizetype start = 0;
        qsizetype length = 0;
        QString family;
    };

    /// `language` (BCP 47) decides the forms of Han characters where the text itself leaves them open.
    explicit FontChoice(QString language = {}) : language_(std::move(language)) {}

    /// The families of a text, from its beginning to its end. Marks stay with what they stand on.
    std::vector<Stretch> stretches(QStringView text) const;
    /// The Noto Sans CJK family for the Han characters of a text.
    QString hanFamily(QStringView text) const;

    /// Regular or bold, and light or thin where they are installed; no weight is ever synthesised.
    static FontSpec spec(const platform::Font& font, int pixelSize, const QString& family);
    /// Whether the family has this style ("Light", "Thin", "Bold") as a font of its own.
    static bool hasStyle(const QString& family, const QString& style);
    static const QString& baseFamily();
    static const QString& emojiFamily();

  private:
    QString language_;
};

}  // namespace ktr::linux_
