#include "server/page/PageBuilder.h"

#include <unicode/brkiter.h>
#include <unicode/uchar.h>
#include <unicode/uscript.h>

#include <memory>

#include "platform/contacts/PersonColor.h"
#include "server/page/PageStyle.h"

namespace ktr::server {

namespace {

const char* classOf(PageBuilder::Button kind) {
    switch (kind) {
        case PageBuilder::Button::Main:
            return "main";
        case PageBuilder::Button::Outlined:
            return "outlined";
        case PageBuilder::Button::Quiet:
            return "quiet";
    }
    return "quiet";
}

/// The first grapheme of a word, in upper case.
icu::UnicodeString initialOf(const icu::UnicodeString& word) {
    UErrorCode status = U_ZERO_ERROR;
    const std::unique_ptr<icu::BreakIterator> breaks(
        icu::BreakIterator::createCharacterInstance(icu::Locale::getRoot(), status));
    if (U_FAILURE(status) || word.isEmpty()) {
        return {};
    }
    breaks->setText(word);
    return icu::UnicodeString(word, 0, breaks->next()).toUpper(icu::Locale::getRoot());
}

/// Two initials; one where letters join or where the family name comes first.
std::string lettersOf(std::string_view name) {
    icu::UnicodeString text =
        icu::UnicodeString::fromUTF8(icu::StringPiece(name.data(), static_cast<int>(name.size())));
    text.trim();
    const int space = text.lastIndexOf(u' ');
    const icu::UnicodeString first = initialOf(text);
    UErrorCode status = U_ZERO_ERROR;
    const UScriptCode script = first.isEmpty() ? USCRIPT_COMMON : uscript_getScript(first.char32At(0), &status);
    const bool hasTwo = script == USCRIPT_LATIN || script == USCRIPT_CYRILLIC || script == USCRIPT_GREEK ||
                        script == USCRIPT_HEBREW || script == USCRIPT_ARMENIAN;
    icu::UnicodeString letters = first;
    if (hasTwo && space > 0) {
        letters += initialOf(icu::UnicodeString(text, space + 1));
    }
    std::string out;
    letters.toUTF8String(out);
    return out;
}

}  // namespace

void PageBuilder::icon(const char* size, const char* path, const char* width, bool flips) {
    html_.open("svg", {{"width", size},
                       {"height", size},
                       {"viewBox", std::string("0 0 ") + size + " " + size},
                       {"fill", "none"},
                       {"stroke", "currentColor"},
                       {"stroke-width", width},
                       {"stroke-linecap", "round"},
                       {"stroke-linejoin", "round"},
                       {"aria-hidden", "true"},
                       {"class", flips ? "flip" : "icon"}});
    html_.leaf("path", {{"d", path}}, "").close();
}

void PageBuilder::chevron() {
    icon("16", "M6.2 4 10.2 8l-4 4", "1.8", true);
}

void PageBuilder::plusIcon() {
    icon("16", "M8 2v12M2 8h12", "1.8", false);
}

void PageBuilder::reloadIcon() {
    icon("16", "M13.5 8a5.5 5.5 0 1 1-1.7-4M13.5 1.8V5h-3.2", "1.8", true);
}

void PageBuilder::brand(std::string_view name) {
    const char* drop = "M-4.35-8.33A4.9 4.9 0 1 1 4.35-8.33L0 0Z";
    html_.open("p", {{"class", "brand"}});
    html_.open("svg", {{"width", "28"}, {"height", "28"}, {"viewBox", "0 0 28 28"}, {"aria-hidden", "true"}});
    html_.leaf("rect", {{"width", "28"}, {"height", "28"}, {"rx", "8.5"}, {"fill", "#1E6653"}}, "");
    for (const bool right : {false, true}) {
        const char* color = right ? "#EF8F14" : "#FBF3E2";
        html_.open("g", {{"transform", right ? "translate(14 22.2) rotate(33)" : "translate(14 22.2) rotate(-33)"}});
        if (right) {
            html_.leaf("path", {{"d", drop}, {"stroke", "#1E6653"}, {"stroke-width", "3.8"}}, "");
        }
        html_.leaf("path", {{"d", drop}, {"fill", color}, {"stroke", color}, {"stroke-width", "0.8"}}, "");
        html_.leaf("circle", {{"cy", "-10.6"}, {"r", "2"}, {"fill", "#1E6653"}}, "").close();
    }
    html_.close().leaf("bdi", {}, shownName(name)).close();
}

void PageBuilder::heading(std::string_view text) {
    html_.leaf("h1", {}, text);
}

void PageBuilder::bar(std::string_view title, const std::string& backTo) {
    html_.open("div", {{"class", "bar"}});
    html_.open("a", {{"href", backTo}, {"aria-label", language_.text("BACK")}});
    icon("20", "M16.5 10H4M9.5 4.5 4 10l5.5 5.5", "2", true);
    html_.close().leaf("h1", {}, title).close();
}

void PageBuilder::section(std::string_view text) {
    html_.leaf("h2", {}, text);
}

void PageBuilder::words(std::string_view text) {
    html_.leaf("p", {{"class", "words"}}, text);
}

void PageBuilder::note(std::string_view text) {
    html_.leaf("p", {{"class", "note"}}, text);
}

void PageBuilder::told(std::string_view text, bool isWarning) {
    html_.open("p", {{"class", "told"}, {"role", isWarning ? "alert" : "status"}});
    if (isWarning) {
        icon("14", "M7 1.6 13 12.2H1zM7 5.4v3.2M7 10.5v.02", "1.5", false);
    }
    html_.leaf("span", {}, text).close();
}

void PageBuilder::warning(std::string_view text) {
    html_.open("p", {{"class", "warn"}});
    icon("14", "M7 1.6 13 12.2H1zM7 5.4v3.2M7 10.5v.02", "1.5", false);
    html_.leaf("span", {}, text).close();
}

void PageBuilder::openCard(const char* more) {
    html_.open("div", {{"class", std::string("card") + more}});
}

void PageBuilder::linkRow(const std::string& target, std::string_view text) {
    html_.open("a", {{"class", "row"}, {"href", target}}).leaf("span", {{"class", "grow"}}, text);
    chevron();
    html_.close();
}

void PageBuilder::face(std::string_view name, std::string_view handle) {
    html_.leaf("span",
               {{"class", "face c" + std::to_string(platform::PersonColor::number(handle))}, {"aria-hidden", "true"}},
               lettersOf(shownName(name)));
}

void PageBuilder::openForm(const std::string& action) {
    html_.open("form", {{"method", "post"}, {"action", action}});
    if (!token_.empty()) {
        hiddenField("token", token_);
    }
}

void PageBuilder::hiddenField(const std::string& name, const std::string& value) {
    html_.single("input", {{"type", "hidden"}, {"name", name}, {"value", value}});
}

void PageBuilder::button(Button kind, std::string_view text) {
    html_.leaf("button", {{"class", classOf(kind)}}, text);
}

void PageBuilder::linkButton(Button kind, const std::string& target, std::string_view text) {
    html_.leaf("a", {{"class", classOf(kind)}, {"href", target}}, text);
}

void PageBuilder::openChoice(const std::string& name, const std::string& value, std::string_view text, bool isChosen) {
    const std::string id = name + "-" + value;
    Html::Attributes box{{"type", "radio"}, {"name", name}, {"value", value}, {"id", id}};
    if (isChosen) {
        box.emplace_back("checked", "");
    }
    html_.open("div", {{"class", "row choice"}}).single("input", box).leaf("label", {{"for", id}}, text);
}

std::string PageBuilder::finish(std::string_view title) {
    const std::string body = html_.take();
    Html page;
    page.markup("<!doctype html>");
    page.open("html", {{"lang", language_.tag()}, {"dir", language_.isRightToLeft() ? "rtl" : "ltr"}});
    page.open("head").single("meta", {{"charset", "utf-8"}}).leaf("title", {}, title);
    page.single("meta", {{"name", "viewport"}, {"content", "width=device-width, initial-scale=1"}});
    page.open("style").markup(PageStyle::sheet()).close().close();
    page.open("body").open("main").markup(body);
    return page.take();
}

}  // namespace ktr::server
