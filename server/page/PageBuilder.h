#pragma once

#include <string>
#include <string_view>

#include "server/page/Html.h"
#include "server/page/PageLanguage.h"

namespace ktr::server {

/// Puts a page of the people's pages together, piece by piece from its top. What all pages have in common stands here:
/// the frame, the icons, the rows, and the token in every form. One thread at a time.
class PageBuilder {
  public:
    enum class Button { Main, Outlined, Quiet };

    /// `token`: what the session's forms carry; empty where nobody is signed in.
    PageBuilder(const PageLanguage& language, std::string token) : language_(language), token_(std::move(token)) {}

    Html& html() { return html_; }
    const PageLanguage& language() const { return language_; }

    /// The program's icon and whose page it is; then the title in large letters.
    void brand(std::string_view name);
    void heading(std::string_view text);
    /// A bar with a title and the way back.
    void bar(std::string_view title, const std::string& backTo);
    void section(std::string_view text);
    void words(std::string_view text);
    void note(std::string_view text);
    /// Something that was done, or went wrong; said by screen readers as the page opens.
    void told(std::string_view text, bool isWarning);
    void warning(std::string_view text);

    void openCard(const char* more = "");
    void close() { html_.close(); }
    /// A row that leads somewhere, with a chevron.
    void linkRow(const std::string& target, std::string_view text);
    /// Somebody's disc with their letters. `handle`: decides its colour.
    void face(std::string_view name, std::string_view handle);

    /// A form that is sent to `action`; close it.
    void openForm(const std::string& action);
    void hiddenField(const std::string& name, const std::string& value);
    void button(Button kind, std::string_view text);
    void linkButton(Button kind, const std::string& target, std::string_view text);
    /// A choice of one of several: a round box and its words; more may follow in the row, which stays open.
    void openChoice(const std::string& name, const std::string& value, std::string_view text, bool isChosen);
    void chevron();
    void reloadIcon();
    void plusIcon();

    /// The whole document; `title` is the browser's own.
    std::string finish(std::string_view title);

  private:
    void icon(const char* size, const char* path, const char* width, bool flips);

    const PageLanguage& language_;
    const std::string token_;
    Html html_;
};

}  // namespace ktr::server
