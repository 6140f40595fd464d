#include "server/ingest/Face.h"

#include "server/ingest/JpegFace.h"
#include "server/ingest/PngFace.h"

namespace ktr::server {

std::optional<std::string> Face::cleaned(std::string_view picture, std::string& complaint) {
    if (picture.size() > kMostGiven) {
        complaint = "is larger than 8 MiB";
        return std::nullopt;
    }
    auto face = PngFace::is(picture)    ? PngFace::cleaned(picture, complaint)
                : JpegFace::is(picture) ? JpegFace::cleaned(picture, complaint)
                                        : std::nullopt;
    if (!face) {
        complaint = complaint.empty() ? "is neither a JPEG nor a PNG" : complaint;
    } else if (face->size() > kMostBytes) {
        complaint = "is larger than 48 KiB without what is not the picture";
        return std::nullopt;
    }
    return face;
}

}  // namespace ktr::server
