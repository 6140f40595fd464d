#include "documents/IsoTime.h"

#include <chrono>

namespace ktr::documents {

namespace {

/// Takes the text apart from its front; every step that does not fit makes the whole none.
class Scanner {
  public:
    explicit Scanner(std::string_view text) : rest_(text) {}

    std::optional<int> digits(std::size_t count) {
        int number = 0;
        if (rest_.size() < count) {
            return std::nullopt;
        }
        for (std::size_t i = 0; i < count; ++i) {
            if (rest_[i] < '0' || rest_[i] > '9') {
                return std::nullopt;
            }
            number = number * 10 + (rest_[i] - '0');
        }
        rest_.remove_prefix(count);
        return number;
    }
    bool take(char c) {
        if (rest_.empty() || rest_.front() != c) {
            return false;
        }
        rest_.remove_prefix(1);
        return true;
    }
    /// The digits after a decimal point, as a fraction of one; at least one digit.
    std::optional<double> fraction() {
        double value = 0.0;
        double place = 0.1;
        std::size_t count = 0;
        while (!rest_.empty() && rest_.front() >= '0' && rest_.front() <= '9') {
            value += place * (rest_.front() - '0');
            place /= 10.0;
            rest_.remove_prefix(1);
            ++count;
        }
        return count > 0 ? std::optional(value) : std::nullopt;
    }
    bool atEnd() const { return rest_.empty(); }

  private:
    std::string_view rest_;
};

std::optional<double> scanDay(Scanner& scanner) {
    const auto year = scanner.digits(4);
    if (!year || !scanner.take('-')) {
        return std::nullopt;
    }
    const auto month = scanner.digits(2);
    if (!month || !scanner.take('-')) {
        return std::nullopt;
    }
    const auto day = scanner.digits(2);
    if (!day) {
        return std::nullopt;
    }
    const std::chrono::year_month_day date{std::chrono::year(*year), std::chrono::month(static_cast<unsigned>(*month)),
                                           std::chrono::day(static_cast<unsigned>(*day))};
    if (!date.ok()) {
        return std::nullopt;
    }
    return static_cast<double>(std::chrono::sys_days(date).time_since_epoch().count()) * 86400.0;
}

std::optional<double> scanTime(Scanner& scanner) {
    const auto hour = scanner.digits(2);
    if (!hour || *hour > 23 || !scanner.take(':')) {
        return std::nullopt;
    }
    const auto minute = scanner.digits(2);
    if (!minute || *minute > 59) {
        return std::nullopt;
    }
    double seconds = *hour * 3600.0 + *minute * 60.0;
    if (scanner.take(':')) {
        const auto second = scanner.digits(2);
        if (!second || *second > 59) {
            return std::nullopt;
        }
        seconds += *second;
        if (scanner.take('.')) {
            const auto fraction = scanner.fraction();
            if (!fraction) {
                return std::nullopt;
            }
            seconds += *fraction;
        }
    }
    return seconds;
}

std::optional<int> scanOffset(Scanner& scanner) {
    if (scanner.take('Z') || scanner.atEnd()) {
        return 0;
    }
    const bool east = scanner.take('+');
    if (!east && !scanner.take('-')) {
        return std::nullopt;
    }
    const auto hours = scanner.digits(2);
    if (!hours || *hours > 23 || !scanner.take(':')) {
        return std::nullopt;
    }
    const auto minutes = scanner.digits(2);
    if (!minutes || *minutes > 59) {
        return std::nullopt;
    }
    const int seconds = *hours * 3600 + *minutes * 60;
    return east ? seconds : -seconds;
}

}  // namespace

std::optional<IsoTime> parseIsoTime(std::string_view text) {
    Scanner scanner(text);
    const auto day = scanDay(scanner);
    if (!day || !scanner.take('T')) {
        return std::nullopt;
    }
    const auto time = scanTime(scanner);
    if (!time) {
        return std::nullopt;
    }
    const auto offset = scanOffset(scanner);
    if (!offset || !scanner.atEnd()) {
        return std::nullopt;
    }
    return IsoTime{{*day + *time - *offset - platform::kSecondsFrom1970ToReferenceDate}, *offset};
}

}  // namespace ktr::documents
