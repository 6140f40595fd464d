#pragma once

#include <cstdint>
#include <initializer_list>
#include <memory>
#include <string>
#include <string_view>
#include <utility>
#include <vector>

namespace ktr::server {

/// A reader's language and time zone: texts, numbers, times. One thread at a time.
class PageLanguage {
  public:
    /// `language` is one of PageTexts::languages(), `zone` a name of the IANA database; UTC for what is not one.
    PageLanguage(const std::string& language, const std::string& zone);
    ~PageLanguage();
    PageLanguage(const PageLanguage&) = delete;
    PageLanguage& operator=(const PageLanguage&) = delete;

    /// The language to answer in: the chosen one if there is such, else the best that Accept-Language (RFC 9110,
    /// 12.5.4) names, else English. "zh-TW" is served by "zh-Hant", "pt-PT" by "pt", "iw" by "he".
    static std::string choose(std::string_view chosen, std::string_view accepted);
    /// What a language calls itself.
    static std::string ownName(const std::string& language);
    static bool isZone(const std::string& name);
    /// Names of zones to choose among, one for each place of the IANA database, sorted.
    static std::vector<std::string> zones();

    const std::string& tag() const { return tag_; }
    const std::string& zone() const { return zone_; }
    bool isRightToLeft() const;

    /// A text with its arguments, each set apart from the text around it whatever direction it has.
    std::string text(std::string_view key, std::initializer_list<std::string> arguments = {}) const;
    /// A text with a branch for each form of a number, which is its first argument: in `words` if there are any, else
    /// in digits.
    std::string plural(std::string_view key, std::int64_t number, const std::string& words = {}) const;

    std::string number(std::int64_t value) const;
    /// "17:44" or "5:44 PM".
    std::string clock(std::int64_t time) const;
    /// "Today, 17:44", "Yesterday, 20:31", "Tomorrow, 08:00", "17 Nov, 20:31".
    std::string moment(std::int64_t time, std::int64_t now) const;
    /// "Today", "17 Nov": without the time of day.
    std::string day(std::int64_t time, std::int64_t now) const;
    /// "4 min. ago".
    std::string age(std::int64_t seconds) const;
    /// "20 m" or "2.8 km".
    std::string metres(double metres) const;
    /// "50.22° north, 3.11° west", to some ten metres if `exact`, else to a kilometre.
    std::string coordinates(double latitude, double longitude, bool exact) const;
    /// "48 hours", "30 days".
    std::string hours(std::int64_t count) const;
    std::string days(std::int64_t count) const;
    /// The hour and minute of a moment in the reader's zone, "22:00", as <input type="time"> has it.
    std::string fieldTime(std::int64_t time) const;

  private:
    struct Formats;

    std::string tag_;
    std::string zone_;
    std::unique_ptr<Formats> formats_;
};

/// A name that somebody else chose, safe to be shown: one line, without marks of direction, at most 60 letters.
std::string shownName(std::string_view name);

}  // namespace ktr::server
