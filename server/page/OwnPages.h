#pragma once

#include <optional>
#include <string>
#include <vector>

#include "server/http/HttpResponse.h"
#include "server/page/PageData.h"
#include "server/page/PageRequest.h"
#include "server/page/SharingPage.h"
#include "server/store/Store.h"

namespace ktr::server {

/// The pages of somebody who is signed in. Every change is the store's own function that the command line uses, too,
/// and is on the disk before its answer. One thread.
class OwnPages {
  public:
    struct Reader {
        const PageContext& context;
        Browser browser;
        Person person;
    };

    explicit OwnPages(Store& store) : store_(store) {}
    /// A post has been found to come from one of the reader's own pages.
    HttpResponse answer(const PageRequest& request, const Reader& reader);

  private:
    HttpResponse show(const PageRequest& request, const Reader& reader);
    HttpResponse change(const PageRequest& request, const Reader& reader);
    HttpResponse showRule(const PageRequest& request, const Reader& reader);
    HttpResponse showPhone(const PageRequest& request, const Reader& reader);
    HttpResponse showDeviceEnd(const PageRequest& request, const Reader& reader);
    HttpResponse changeVisible(const PageRequest& request, const Reader& reader);
    HttpResponse beginSharing(const PageRequest& request, const Reader& reader);
    HttpResponse changeRule(const PageRequest& request, const Reader& reader);
    HttpResponse stopSharing(const PageRequest& request, const Reader& reader);
    HttpResponse makePhone(const PageRequest& request, const Reader& reader);
    /// With which a program signs in.
    HttpResponse makeLink(const PageRequest& request, const Reader& reader);
    HttpResponse endDevice(const PageRequest& request, const Reader& reader);
    HttpResponse changeSettings(const PageRequest& request, const Reader& reader);
    HttpResponse deleteAll(const Reader& reader);
    HttpResponse placesPage(const Reader& reader, int status, const std::string& typed, const char* complaint);
    /// The page that changes it, or the one that asks before its name goes.
    HttpResponse showPlace(const PageRequest& request, const Reader& reader);
    HttpResponse changePlace(const PageRequest& request, const Reader& reader);
    HttpResponse changePlaces(const PageRequest& request, const Reader& reader);

    SharingPage::Data sharingOf(const Reader& reader);
    std::vector<PageLook> looksOf(const Reader& reader);
    std::vector<PageDevice> devicesOf(const Reader& reader);
    std::optional<PageRule> ruleOf(const Reader& reader, std::int64_t viewer);
    std::string ruleHtml(const Reader& reader, const PageRule& rule, const std::string& told, bool isComplaint);
    /// Whom the words name: somebody's name or handle; none for nobody.
    std::optional<Person> named(const std::string& words);

    Store& store_;
};

}  // namespace ktr::server
