#include "ask/Template.h"

#include <algorithm>
#include <optional>

#include "ask/FoldedText.h"

namespace ktr::ask {

namespace {

using Part = Template::Part;

bool isBlank(char c) {
    return c == ' ' || c == '\t' || c == '\n' || c == '\r';
}

class Reader {
  public:
    explicit Reader(std::string_view text) : text_(text) {}

    Part readAll() {
        Part all = alternatives(0);
        if (!error_ && at_ < text_.size()) {
            fail(std::string("nothing opens this \"") + text_[at_] + "\"");
        }
        return all;
    }
    const std::optional<Template::Error>& error() const { return error_; }

  private:
    void fail(const std::string& message) {
        if (!error_) {
            error_ = Template::Error{at_ + 1, message};
        }
        at_ = text_.size();
    }

    /// Up to a bracket that closes, or the end.
    Part alternatives(std::size_t depth) {
        Part choice{Part::Kind::Alternatives};
        choice.parts.push_back(sequence(depth));
        while (at_ < text_.size() && text_[at_] == '|') {
            ++at_;
            choice.parts.push_back(sequence(depth));
        }
        if (choice.parts.size() > 1) {
            return choice;
        }
        Part only = std::move(choice.parts.front());
        return only;
    }

    Part sequence(std::size_t depth) {
        Part all;
        while (at_ < text_.size()) {
            const char c = text_[at_];
            if (c == '|' || c == ')' || c == ']') {
                break;
            }
            if (c == '(' || c == '[') {
                all.parts.push_back(bracketed(c == '(' ? ')' : ']', depth));
            } else if (c == '{' || c == '<') {
                all.parts.push_back(named(c == '{' ? '}' : '>'));
            } else if (c == '}' || c == '>') {
                fail(std::string("nothing opens this \"") + c + "\"");
            } else {
                all.parts.push_back(words());
            }
        }
        return all;
    }

    Part bracketed(char closing, std::size_t depth) {
        if (depth == Template::kDeepest) {
            fail("brackets are nested too deeply");
            return {};
        }
        ++at_;
        Part inner = alternatives(depth + 1);
        if (at_ >= text_.size() || text_[at_] != closing) {
            fail(std::string("a \"") + closing + "\" is missing");
            return {};
        }
        ++at_;
        if (closing == ')') {
            return inner;
        }
        Part optional{Part::Kind::Alternatives};
        optional.parts.push_back(std::move(inner));
        optional.parts.emplace_back();
        return optional;
    }

    Part named(char closing) {
        const std::size_t begin = ++at_;
        while (at_ < text_.size() && (std::isalnum(static_cast<unsigned char>(text_[at_])) != 0 || text_[at_] == '_')) {
            ++at_;
        }
        if (at_ == begin || at_ >= text_.size() || text_[at_] != closing) {
            fail(std::string("expected a name of letters, digits and \"_\", and a \"") + closing + "\"");
            return {};
        }
        Part part{closing == '}' ? Part::Kind::Slot : Part::Kind::Rule};
        part.name = std::string(text_.substr(begin, at_ - begin));
        ++at_;
        return part;
    }

    /// A blank that stands beside a bracket stays: it parts words there.
    Part words() {
        const std::size_t begin = at_;
        at_ = std::min(text_.find_first_of("|()[]{}<>", at_), text_.size());
        const std::string_view written = text_.substr(begin, at_ - begin);
        Part part{Part::Kind::Words};
        part.text = FoldedText::of(written);
        // Between an hour's slot and a minute's it is no punctuation.
        if (written == ":" || written == ".") {
            part.text.assign(1, static_cast<char32_t>(written.front()));
        }
        if (isBlank(written.front())) {
            part.text.insert(part.text.begin(), U' ');
        }
        if (isBlank(written.back()) && part.text != U" ") {
            part.text.push_back(U' ');
        }
        return part;
    }

    std::string_view text_;
    std::size_t at_ = 0;
    std::optional<Template::Error> error_;
};

}  // namespace

std::variant<Part, Template::Error> Template::read(std::string_view text) {
    if (text.size() > kLongest) {
        return Error{kLongest, "the template is too long"};
    }
    Reader reader(text);
    Part all = reader.readAll();
    if (reader.error()) {
        return *reader.error();
    }
    return all;
}

}  // namespace ktr::ask
