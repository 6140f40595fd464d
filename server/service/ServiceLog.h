#pragma once

#include <chrono>
#include <cstdint>
#include <initializer_list>
#include <map>
#include <mutex>
#include <string>
#include <string_view>
#include <variant>

namespace ktr::server {

/// What the service says of itself to whoever runs it: one line an event, `event=request route=phone status=503`, made
/// of numbers and of words that stand in the program. A text that came from outside (a name, a place, a secret, a path)
/// cannot be written: the compiler refuses it. Never waits: what nobody reads is dropped and counted. Any thread.
class ServiceLog {
  public:
    /// A word of the program's own.
    class Word {
      public:
        // NOLINTNEXTLINE(google-explicit-constructor): a literal is one.
        consteval Word(const char* literal) : text_(literal) {}
        constexpr std::string_view text() const { return text_; }

      private:
        std::string_view text_;
    };
    enum class Level { Error = 3, Warning = 4, Info = 6 };
    struct Field {
        Word key;
        std::variant<std::int64_t, Word> value;
    };
    using Clock = std::chrono::steady_clock;

    /// Of one event at most so many lines a minute; how many were left out stands in its next line.
    static constexpr int kLinesAMinute = 60;

    /// To a descriptor that it does not own. Where the journal reads it, a line begins with its level ("<4>"), else
    /// with the time.
    explicit ServiceLog(int descriptor);

    void write(Level level, Word event, std::initializer_list<Field> fields = {}, Clock::time_point now = Clock::now());

  private:
    struct Count {
        Clock::time_point minute;
        int lines = 0;
        std::int64_t leftOut = 0;
    };

    /// False when the line is one too many; else how many were left out before it.
    bool mayWrite(Word event, Clock::time_point now, std::int64_t& leftOut);
    std::string head(Level level) const;

    const int descriptor_;
    const bool isJournal_;
    std::mutex mutex_;
    std::map<std::string_view, Count> counts_;
};

}  // namespace ktr::server
