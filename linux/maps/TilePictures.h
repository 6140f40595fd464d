#pragma once

#include <functional>
#include <optional>
#include <string>

#include "platform/ui/Image.h"
#include "tiles/TileKey.h"
#include "tiles/TilesetFacts.h"

namespace ktr::linux_ {

/// Where pictures of map tiles come from. One thread at a time, but for what says otherwise.
class TilePictures {
  public:
    struct Answer {
        std::optional<platform::Bytes> data;  ///< PNG or JPEG, not checked
        bool isComing = false;                ///< there will be one, or a newer one, later
        /// Grows when another picture takes this one's place.
        unsigned version = 0;
    };

    virtual ~TilePictures();
    /// Whether it can be asked now: asked before each drawing.
    virtual bool open() = 0;
    virtual int coarsest() const = 0;
    virtual int finest() const = 0;
    /// The part of the world that it covers; none for all.
    virtual std::optional<tiles::TilesetFacts::Bounds> bounds() const { return std::nullopt; }
    virtual std::string attribution() const = 0;
    /// `isWanted`: fetch it where that takes a while; else only what is cached is of use.
    virtual Answer tile(const tiles::TileKey& key, bool isWanted) = 0;
    /// As MapGround's.
    virtual void setChangeHandler(std::function<void()> changed);
};

}  // namespace ktr::linux_
