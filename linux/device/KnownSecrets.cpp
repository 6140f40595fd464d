#include "linux/device/KnownSecrets.h"

#include <algorithm>
#include <cctype>
#include <string_view>

#include "platform/base/Json.h"

namespace ktr::linux_ {

namespace {

constexpr std::string_view kHidden = "<hidden>";
constexpr std::string_view kMember = "authToken";
constexpr std::size_t kShortest = 4;

std::string percentEscaped(const std::string& text, const char* digits) {
    std::string out;
    for (const char c : text) {
        const auto byte = static_cast<unsigned char>(c);
        if (std::isalnum(byte) != 0 || std::string_view("-._~").find(c) != std::string_view::npos) {
            out += c;
        } else {
            out += '%';
            out += digits[byte >> 4U];
            out += digits[byte & 15U];
        }
    }
    return out;
}

void replaceAll(std::string& text, const std::string& what) {
    for (auto at = text.find(what); at != std::string::npos; at = text.find(what, at + kHidden.size())) {
        text.replace(at, what.size(), kHidden);
    }
}

/// What stands between a member's name and its value, however often the JSON or the URL around it was escaped again.
class Separator {
  public:
    explicit Separator(std::string_view text) : rest_(text) {}

    /// Its length; none when this is no member with a value.
    std::size_t length() {
        const std::size_t whole = rest_.size();
        takeQuotes();
        if (!take(":") && !take("=") && !take("%3A") && !take("%3a") && !take("%3D") && !take("%3d")) {
            return 0;
        }
        quoted_ = takeQuotes();
        return whole - rest_.size();
    }
    bool isQuoted() const { return quoted_; }

  private:
    bool take(std::string_view what) {
        if (!rest_.starts_with(what)) {
            return false;
        }
        rest_.remove_prefix(what.size());
        return true;
    }
    /// Blanks, backslashes and quotes; whether there was a quote.
    bool takeQuotes() {
        bool quote = false;
        for (;;) {
            if (take("\"") || take("'") || take("%22")) {
                quote = true;
            } else if (!take(" ") && !take("\\") && !take("%5C") && !take("%5c") && !take("%20")) {
                return quote;
            }
        }
    }

    std::string_view rest_;
    bool quoted_ = false;
};

std::size_t endOfValue(std::string_view text, bool quoted) {
    for (std::size_t at = 0; at < text.size(); ++at) {
        const char c = text[at];
        if (quoted && c == '\\' && at + 1 < text.size() && text[at + 1] != '"') {
            ++at;
        } else if (c == '"' || c == '\\' || text.substr(at, 3) == "%22" || text.substr(at, 3) == "%26" ||
                   (!quoted && std::string_view(",}]&# \n").find(c) != std::string_view::npos)) {
            return at;
        }
    }
    return text.size();
}

void hideMembers(std::string& text) {
    for (auto at = text.find(kMember); at != std::string::npos; at = text.find(kMember, at)) {
        at += kMember.size();
        Separator separator(std::string_view(text).substr(at));
        const std::size_t length = separator.length();
        if (length > 0) {
            const std::size_t begin = at + length;
            const std::size_t size = endOfValue(std::string_view(text).substr(begin), separator.isQuoted());
            text.replace(begin, size, kHidden);
            at = begin + kHidden.size();
        }
    }
}

}  // namespace

void KnownSecrets::add(const std::string& secret) {
    if (secret.size() < kShortest) {
        return;
    }
    const std::string json = platform::writeJsonString(secret);
    const std::lock_guard lock(mutex_);
    for (const std::string& form : {secret, json.substr(1, json.size() - 2), percentEscaped(secret, "0123456789ABCDEF"),
                                    percentEscaped(secret, "0123456789abcdef")}) {
        if (std::find(forms_.begin(), forms_.end(), form) == forms_.end()) {
            forms_.push_back(form);
        }
    }
    std::stable_sort(forms_.begin(), forms_.end(),
                     [](const std::string& a, const std::string& b) { return a.size() > b.size(); });
}

std::string KnownSecrets::without(std::string text) const {
    hideMembers(text);
    const std::lock_guard lock(mutex_);
    for (const std::string& form : forms_) {
        replaceAll(text, form);
    }
    return text;
}

}  // namespace ktr::linux_
