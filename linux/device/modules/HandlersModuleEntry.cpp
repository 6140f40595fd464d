#include <gio/gio.h>

#include <memory>

#include "linux/device/HandlersModule.h"

namespace {

struct Free {
    void operator()(GAppInfo* program) const { g_object_unref(program); }
    void operator()(GError* error) const { g_error_free(error); }
    void operator()(char* text) const { g_free(text); }
};

}  // namespace

extern "C" __attribute__((visibility("default"))) bool ktrOpenWithHandler(const std::string& url, std::string& error) {
    const std::unique_ptr<char, Free> scheme(g_uri_parse_scheme(url.c_str()));
    if (!scheme) {
        error = "no URL";
        return false;
    }
    const std::unique_ptr<GAppInfo, Free> program(g_app_info_get_default_for_uri_scheme(scheme.get()));
    if (!program) {
        error = std::string("no program is there for ") + scheme.get();
        return false;
    }
    // The library reads the list, whose texts it does not change.
    GList urls{const_cast<char*>(url.c_str()), nullptr, nullptr};
    GError* raw = nullptr;
    const bool started = g_app_info_launch_uris(program.get(), &urls, nullptr, &raw) != FALSE;
    const std::unique_ptr<GError, Free> failure(raw);
    if (!started) {
        error = failure ? failure->message : "it does not start";
    }
    return started;
}
