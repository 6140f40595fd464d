#include "linux/paint/PreparedText.h"

#include <algorithm>

#include "linux/paint/JapanesePhrases.h"
#include "platform/base/Utf8.h"

namespace ktr::linux_ {

namespace {

constexpr char16_t kReplacement = 0xFFFD;

bool isEmbeddingStart(char16_t c) {
    return c == 0x202A || c == 0x202B || c == 0x202D || c == 0x202E;
}
bool isIsolateStart(char16_t c) {
    return c >= 0x2066 && c <= 0x2068;
}
constexpr char16_t kPopEmbedding = 0x202C;
constexpr char16_t kPopIsolate = 0x2069;

constexpr char16_t kFirstStrongIsolate = 0x2068;

bool isLineEnd(char16_t c) {
    return c == u'\n' || c == u'\r' || c == 0x0B || c == 0x0C || c == 0x85 || c == 0x2028 || c == 0x2029;
}

bool isControl(char16_t c) {
    return c < 0x20 || (c >= 0x7F && c < 0xA0) || c == 0xFFFC;
}

/// What closes the embeddings, overrides and isolates that are open at a run's end. The bidirectional algorithm ignores
/// what is nested deeper than 125, so no more need closing.
QString closers(const QString& text) {
    QString open;
    constexpr qsizetype kDeepest = 125;
    for (const QChar ch : text) {
        const char16_t c = ch.unicode();
        if (isEmbeddingStart(c)) {
            open.append(QChar(kPopEmbedding));
        } else if (isIsolateStart(c)) {
            open.append(QChar(kPopIsolate));
        } else if (c == kPopEmbedding && open.endsWith(QChar(kPopEmbedding))) {
            open.chop(1);
        } else if (c == kPopIsolate && open.contains(QChar(kPopIsolate))) {
            open.truncate(open.lastIndexOf(QChar(kPopIsolate)));
        }
        open.truncate(kDeepest);
    }
    std::reverse(open.begin(), open.end());
    return open;
}

/// Whether anything but blanks and line ends stands in the text.
bool hasWords(const QString& text) {
    return std::any_of(text.begin(), text.end(), [](QChar c) { return !c.isSpace(); });
}

QString cleaned(const std::string& utf8) {
    QString text = QString::fromStdString(platform::sanitizedUtf8(utf8));
    text.replace(QStringLiteral("\r\n"), QStringLiteral("\n"));
    for (QChar& ch : text) {
        const char16_t c = ch.unicode();
        if (isLineEnd(c)) {
            ch = QChar(QChar::LineSeparator);
        } else if (c == u'\t') {
            ch = QChar(u' ');
        } else if (isControl(c)) {
            ch = QChar(kReplacement);
        }
    }
    return text;
}

}  // namespace

PreparedText::PreparedText(const platform::AttributedString& source, Options options) {
    for (const auto& run : source.runs()) {
        QString piece = cleaned(run.text);
        if (options.joinsPhrases) {
            piece = JapanesePhrases::joined(piece);
        }
        if (!options.keepsSoftHyphens) {
            piece.remove(QChar(QChar::SoftHyphen));
        }
        piece.append(closers(piece));
        if (run.paragraph.writingDirection != platform::WritingDirection::Natural && hasWords(piece)) {
            piece = QChar(kFirstStrongIsolate) + piece + QChar(kPopIsolate);
        }
        runs.push_back({text.size(), piece.size(), run.font, run.color, run.paragraph});
        text.append(piece);
    }
    while (!options.keepsLineEnds && text.endsWith(QChar(QChar::LineSeparator))) {
        text.chop(1);
    }
    while (!runs.empty() && runs.back().start >= text.size()) {
        runs.pop_back();
    }
    if (!runs.empty()) {
        runs.back().length = text.size() - runs.back().start;
    }
}

const PreparedText::Run& PreparedText::runAt(qsizetype position) const {
    const auto after = std::upper_bound(runs.begin(), runs.end(), position,
                                        [](qsizetype at, const Run& run) { return at < run.start; });
    return after == runs.begin() ? runs.front() : *(after - 1);
}

bool PreparedText::isRightToLeft(qsizetype from, qsizetype to, bool otherwise) const {
    int isolates = 0;
    for (qsizetype i = from; i < to; ++i) {
        char32_t c = text[i].unicode();
        if (text[i].isHighSurrogate() && i + 1 < text.size()) {
            c = QChar::surrogateToUcs4(text[i], text[i + 1]);
            ++i;
        }
        if (c >= 0x2066 && c <= 0x2068) {
            ++isolates;
        } else if (c == kPopIsolate) {
            isolates = std::max(0, isolates - 1);
        } else if (isolates == 0) {
            const QChar::Direction direction = QChar::direction(c);
            if (direction == QChar::DirL) {
                return false;
            }
            if (direction == QChar::DirR || direction == QChar::DirAL) {
                return true;
            }
        }
    }
    return otherwise;
}

QString PreparedText::ellipsisAfter(qsizetype from, qsizetype end) const {
    QString tail(QChar(0x2026));
    // At the end of right-to-left text the ellipsis goes to the left of it, whatever the line's own direction is, and
    // the other way round: a mark of that direction behind it takes it there.
    for (qsizetype i = end; i-- > from;) {
        char32_t c = text[i].unicode();
        if (text[i].isLowSurrogate() && i > from) {
            --i;
            c = QChar::surrogateToUcs4(text[i], text[i + 1]);
        }
        const QChar::Direction direction = QChar::direction(c);
        if (direction == QChar::DirR || direction == QChar::DirAL) {
            return tail + QChar(0x200F);
        }
        if (direction == QChar::DirL || direction == QChar::DirEN || direction == QChar::DirAN) {
            return tail + QChar(0x200E);
        }
    }
    return tail;
}

}  // namespace ktr::linux_
