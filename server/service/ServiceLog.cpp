#include "server/service/ServiceLog.h"

#include <poll.h>
#include <sys/stat.h>
#include <unistd.h>

#include <cstdlib>
#include <ctime>

namespace ktr::server {

namespace {

/// So long a line goes into a pipe as a whole or not at all, once the pipe says that it has room.
constexpr std::size_t kLongest = 4096;

/// Whether the journal reads what is written there: it says so with the file's numbers.
bool isJournal(int descriptor) {
    const char* stream = std::getenv("JOURNAL_STREAM");
    struct stat facts {};
    return stream != nullptr && ::fstat(descriptor, &facts) == 0 &&
           std::to_string(facts.st_dev) + ":" + std::to_string(facts.st_ino) == stream;
}

std::string_view wordOf(ServiceLog::Level level) {
    return level == ServiceLog::Level::Error ? "error" : level == ServiceLog::Level::Warning ? "warning" : "info";
}

}  // namespace

ServiceLog::ServiceLog(int descriptor) : descriptor_(descriptor), isJournal_(isJournal(descriptor)) {}

bool ServiceLog::mayWrite(Word event, Clock::time_point now, std::int64_t& leftOut) {
    Count& count = counts_[event.text()];
    if (count.lines == 0 || now - count.minute >= std::chrono::minutes(1)) {
        count.minute = now;
        count.lines = 0;
    }
    if (count.lines >= kLinesAMinute) {
        ++count.leftOut;
        return false;
    }
    ++count.lines;
    leftOut = count.leftOut;
    count.leftOut = 0;
    return true;
}

std::string ServiceLog::head(Level level) const {
    const std::string word = "level=" + std::string(wordOf(level));
    if (isJournal_) {
        return "<" + std::to_string(static_cast<int>(level)) + ">" + word;
    }
    const std::time_t now = std::time(nullptr);
    std::tm face{};
    ::gmtime_r(&now, &face);
    char text[32];
    std::strftime(text, sizeof text, "%Y-%m-%dT%H:%M:%SZ", &face);
    return "time=" + std::string(text) + " " + word;
}

void ServiceLog::write(Level level, Word event, std::initializer_list<Field> fields, Clock::time_point now) {
    const std::lock_guard<std::mutex> lock(mutex_);
    std::int64_t leftOut = 0;
    if (!mayWrite(event, now, leftOut)) {
        return;
    }
    std::string line = head(level) + " event=" + std::string(event.text());
    for (const Field& field : fields) {
        const auto* word = std::get_if<Word>(&field.value);
        line += " " + std::string(field.key.text()) + "=" +
                (word != nullptr ? std::string(word->text()) : std::to_string(std::get<std::int64_t>(field.value)));
    }
    line += leftOut > 0 ? " left_out=" + std::to_string(leftOut) + "\n" : "\n";
    pollfd room{descriptor_, POLLOUT, 0};
    if (line.size() > kLongest || ::poll(&room, 1, 0) != 1 || (room.revents & POLLOUT) == 0 ||
        ::write(descriptor_, line.data(), line.size()) < 0) {
        counts_[event.text()].leftOut += leftOut + 1;
    }
}

}  // namespace ktr::server
