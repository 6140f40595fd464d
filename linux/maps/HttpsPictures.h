#pragma once

#include <chrono>
#include <cstdint>
#include <filesystem>
#include <map>
#include <memory>
#include <mutex>
#include <string>
#include <vector>

#include "linux/maps/TilePictures.h"
#include "linux/maps/TileStore.h"
#include "linux/net/HttpsClient.h"

namespace ktr::linux_ {

/// Pictures of tiles from a server, one at a time as maps show them, kept on disk by the server's word. A request says
/// which tile and that this program asks; no cookie, no name, no referrer, and no redirect is followed. A server that
/// cannot be reached is left alone, the longer the more often. Made and ended on the main thread; `tile` in one thread
/// at a time.
class HttpsPictures final : public TilePictures {
  public:
    struct Settings {
        std::string url;  ///< with "{z}", "{x}" and "{y}"
        std::string attribution;
        int coarsest = 0;
        int finest = 19;
        std::filesystem::path cacheFolder;
        std::uint64_t cacheBytes = 0;
        /// Trusted besides the system's (PEM).
        std::vector<std::string> certificateFiles;
    };

    /// Without a thread it has one of its own.
    explicit HttpsPictures(Settings settings, std::shared_ptr<NetworkThread> thread = nullptr);
    /// Requests under way are given up.
    ~HttpsPictures() override;
    HttpsPictures(const HttpsPictures&) = delete;
    HttpsPictures& operator=(const HttpsPictures&) = delete;

    bool open() override { return true; }
    int coarsest() const override { return settings_.coarsest; }
    int finest() const override { return settings_.finest; }
    std::string attribution() const override { return settings_.attribution; }
    Answer tile(const tiles::TileKey& key, bool isWanted) override;
    void setChangeHandler(std::function<void()> changed) override;

  private:
    class Fetcher;
    /// What is known of a tile besides what is on disk.
    struct State {
        unsigned version = 0;
        bool isUnderWay = false;
        bool isGone = false;                              ///< the server has none
        std::chrono::steady_clock::time_point notBefore;  ///< of the next request
        std::optional<platform::Bytes> unstored;          ///< what must not be kept on disk
    };

    Settings settings_;
    std::shared_ptr<TileStore> store_;
    std::mutex mutex_;
    std::map<tiles::TileKey, State> states_;
    std::function<void()> changed_;
    std::shared_ptr<NetworkThread> thread_;
    /// Lives on the network thread and is deleted there.
    Fetcher* fetcher_;
};

}  // namespace ktr::linux_
