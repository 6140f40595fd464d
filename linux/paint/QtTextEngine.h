#pragma once

#include <QString>
#include <list>
#include <memory>
#include <mutex>
#include <unordered_map>

#include "linux/paint/FontChoice.h"
#include "linux/paint/LineShaper.h"
#include "linux/paint/QtTextImage.h"
#include "linux/paint/QtTextLayout.h"
#include "linux/paint/TextKey.h"
#include "platform/text/TextEngine.h"

namespace ktr::linux_ {

/// Shapes text with Qt. See platform::TextEngine. Notes beyond it:
/// - A text's direction is its first strong character's, the interface's without one, unless its style says it.
/// - With a limit of lines only as much text is shaped as can fit, however long it is. No line is measured wider than
///   32,000 points: a longer one counts as cut.
/// - Words are hyphenated at soft hyphens alone: a hyphenation factor above 0 has no dictionary to use.
/// - What was shaped is kept, the least recently used layouts are dropped.
/// Any thread, while a QGuiApplication exists.
class QtTextEngine final : public platform::TextEngine {
  public:
    /// `language` (BCP 47) decides the forms of Han characters.
    explicit QtTextEngine(const QString& language = {});

    std::shared_ptr<const platform::TextLayout> layOut(const platform::AttributedString& text,
                                                       const platform::TextContainer& container) override;
    /// Of what this engine laid out, in the colours that text images were painted in last.
    std::shared_ptr<platform::TextImage> image(std::shared_ptr<const platform::TextLayout> layout,
                                               const platform::Size& size, double scale) override;
    /// Drops what was kept: fonts depend on the language.
    void setLanguage(const QString& language);
    /// How many texts were shaped: what is asked for again is not.
    std::size_t shapedCount() const;

  private:
    struct Entry {
        TextKey key;
        std::size_t hash = 0;
        std::shared_ptr<const QtTextLayout> layout;
        std::size_t cost = 0;
    };
    using Entries = std::list<Entry>;
    Entries::iterator entry(std::size_t hash, const TextKey& key);
    void dropOldest();

    std::shared_ptr<const QtTextLayout> layOutOnce(const platform::AttributedString& text,
                                                   const platform::TextContainer& container);
    std::shared_ptr<const QtTextLayout> aligned(const platform::AttributedString& text,
                                                const platform::TextContainer& container);
    std::shared_ptr<const QtTextLayout> shape(const TextKey& key, const platform::AttributedString& text,
                                              const platform::TextContainer& container);
    std::shared_ptr<const QtTextLayout> shapedAsLabel(const TextKey& key, const PreparedText& prepared,
                                                      const platform::TextContainer& container,
                                                      const FontChoice& fonts);
    std::shared_ptr<const QtTextLayout> find(std::size_t hash, const TextKey& key);
    void keep(Entry entry);

    std::shared_ptr<QtTextImage::LastPalette> lastPalette_ =
        std::make_shared<QtTextImage::LastPalette>(&Palette::of(ColorScheme::Light));
    mutable std::mutex mutex_;
    FontChoice fonts_;
    /// Most recently used first.
    Entries entries_;
    /// By hash of the key.
    std::unordered_multimap<std::size_t, Entries::iterator> index_;
    std::size_t cost_ = 0;
    std::size_t shaped_ = 0;
    /// The main thread's.
    LineShaper labels_;
};

}  // namespace ktr::linux_
