#include <libdeflate.h>

#include <cstddef>
#include <cstdint>
#include <string>

#include "server/ingest/Face.h"
#include "tests/fuzz/Require.h"

// Any bytes as a face: what is kept of them is small, and nothing more could be left out of it.

namespace {

/// The same with right checksums, which no search would find: what is behind them is to be searched, too.
std::string withChecksums(std::string picture) {
    std::size_t at = 8;
    while (picture.size() >= at + 12) {
        std::size_t size = 0;
        for (std::size_t i = at; i < at + 4; ++i) {
            size = size << 8U | static_cast<unsigned char>(picture[i]);
        }
        if (size > picture.size() - at - 12) {
            break;
        }
        const std::uint32_t sum = libdeflate_crc32(0, picture.data() + at + 4, 4 + size);
        for (unsigned i = 0; i < 4; ++i) {
            picture[at + 8 + size + i] = static_cast<char>(sum >> (24U - 8U * i) & 0xFFU);
        }
        at += 12 + size;
    }
    return picture;
}

void check(const std::string& picture) {
    using ktr::fuzz::require;
    using ktr::server::Face;
    std::string complaint;
    const auto face = Face::cleaned(picture, complaint);
    require(face.has_value() == complaint.empty(), "who is refused hears why");
    if (face) {
        require(face->size() <= Face::kMostBytes, "a face is small");
        require(Face::cleaned(*face, complaint) == face, "what is clean stays as it is");
    }
}

}  // namespace

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size) {
    const std::string picture(reinterpret_cast<const char*>(data), size);
    check(picture);
    check(withChecksums(picture));
    return 0;
}
