#include <algorithm>
#include <cstddef>
#include <cstdint>
#include <string>
#include <string_view>

#include "server/page/Html.h"
#include "server/page/PageAnswer.h"
#include "server/page/PageRequest.h"
#include "server/page/PageTexts.h"
#include "server/page/RuleForm.h"
#include "tests/fuzz/Require.h"

// Any bytes as what a browser sends to people's pages: a line each of target, cookies and languages, then a form.

namespace {

using ktr::fuzz::require;
using namespace ktr::server;

constexpr std::int64_t kNow = 1763760000;

std::string_view takeLine(std::string_view& bytes) {
    const std::size_t end = std::min(bytes.find('\n'), bytes.size());
    const std::string_view line = bytes.substr(0, end);
    bytes.remove_prefix(std::min(end + 1, bytes.size()));
    return line;
}

void checkGrant(const UrlQuery& form, const PageLanguage& language) {
    const PageContext context{language, "token", kNow, "Mara", "mara@x.example"};
    const std::vector<NamedPlace> places = {{7, "Home", "home", 50.0, 8.0, 150.0, true}};
    const auto [grant, complaint] = RuleForm::read(form, context, places, std::nullopt);
    require(grant.has_value() == (complaint == nullptr), "a grant, or why there is none");
    if (!grant) {
        return;
    }
    const std::string until = form.find("until").value_or("");
    require(grant->from == kNow, "nothing from before is seen");
    require(grant->until.has_value() == (until == "midnight" || until == "time"), "an end where one was chosen");
    require(!grant->until || (*grant->until > kNow && *grant->until <= kNow + 2 * 86400), "the next such time");
    require(grant->arrival == 0 || (grant->arrival == 7 && until == "arrival"), "a place of one's own");
    require(grant->aloud == (form.find("aloud") == "yes"), "said aloud by choice alone");
}

}  // namespace

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size) {
    static const PageLanguage language("en", "Europe/Berlin");
    std::string_view bytes(reinterpret_cast<const char*>(data), size);
    const std::string target(takeLine(bytes));
    HttpRequest request;
    request.method = "POST";
    request.path = "/me/" + target.substr(0, target.find('?'));
    request.query = target.find('?') == std::string::npos ? "" : target.substr(target.find('?') + 1);
    const std::string cookies(takeLine(bytes));
    request.headers = {{"Host", "home.example"},
                       {"Cookie", cookies},
                       {"Accept-Language", std::string(takeLine(bytes))},
                       {"Content-Type", "application/x-www-form-urlencoded"},
                       {"Origin", "null"}};
    request.body = bytes;
    require(PageRequest::isFor(request), "a page");
    const PageRequest page = PageRequest::read(request);
    require(!page.isOwn, "a form from nowhere");
    require(!page.parts.empty(), "the path has parts");
    for (std::size_t part = 0; part < page.parts.size(); ++part) {
        require(page.parts[part].find('/') == std::string::npos, "parts are apart");
        page.number(part);
    }
    require(page.session.find(';') == std::string::npos, "one cookie");
    require(page.session.empty() ||
                cookies.find(std::string(PageAnswer::kSession) + "=" + page.session) != std::string::npos,
            "a session that the browser named");
    const auto& known = PageTexts::languages();
    const std::string chosen = PageLanguage::choose(page.language, page.accepted);
    require(std::find(known.begin(), known.end(), chosen) != known.end(), "a language that there is");
    checkGrant(page.form, language);
    for (const char* name : {"who", "name", "link"}) {
        const std::string shown = Html::escaped(shownName(page.field(name)));
        require(shown.find_first_of("<>\"'\n\r") == std::string::npos, "a text is no markup");
    }
    return 0;
}
