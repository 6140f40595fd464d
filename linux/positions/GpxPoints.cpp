#include "linux/positions/GpxPoints.h"

#include <expat.h>

#include <charconv>
#include <cmath>
#include <memory>
#include <string_view>

#include "documents/IsoTime.h"

namespace ktr::linux_ {

namespace {

using documents::DocumentError;
using documents::JsonPosition;

constexpr double kMetresAtUnitDilution = 5.0;
constexpr double kMostDilution = 100000.0;
constexpr double kOrdinaryAccuracy = 10.0;
/// Each open element costs memory, however short it is written.
constexpr std::size_t kDeepest = 64;
/// Of a number or a time.
constexpr std::size_t kLongestText = 100;

std::string_view trimmed(std::string_view text) {
    constexpr std::string_view kWhite = " \t\r\n";
    const std::size_t first = text.find_first_not_of(kWhite);
    return first == std::string_view::npos ? std::string_view()
                                           : text.substr(first, text.find_last_not_of(kWhite) - first + 1);
}

double numberOf(std::string_view text) {
    text = trimmed(text);
    if (text.starts_with('+')) {
        text.remove_prefix(1);
    }
    double number = 0.0;
    const char* end = text.data() + text.size();
    const auto [stop, error] = std::from_chars(text.data(), end, number);
    return error == std::errc() && stop == end ? number : std::nan("");
}

/// One document, from its first element to the first error.
class Pass {
  public:
    explicit Pass(const std::string& file) : file_(file), parser_(XML_ParserCreate(nullptr), &XML_ParserFree) {}

    std::variant<GpxPoints, DocumentError> run(const std::string& text) {
        XML_Parser parser = parser_.get();
        if (parser == nullptr) {
            return DocumentError{file_, std::nullopt, "", "there is not enough memory to read it"};
        }
        XML_SetUserData(parser, this);
        XML_SetElementHandler(
            parser,
            [](void* self, const XML_Char* name, const XML_Char** attributes) { of(self).begin(name, attributes); },
            [](void* self, const XML_Char*) { of(self).end(); });
        XML_SetCharacterDataHandler(parser, [](void* self, const XML_Char* characters, int length) {
            of(self).add({characters, static_cast<std::size_t>(length)});
        });
        XML_SetStartDoctypeDeclHandler(parser, [](void* self, const XML_Char*, const XML_Char*, const XML_Char*, int) {
            of(self).fail("expected GPX, found a document type");
        });
        const bool whole = XML_Parse(parser, text.data(), static_cast<int>(text.size()), XML_TRUE) == XML_STATUS_OK;
        if (error_) {
            return *error_;
        }
        if (!whole) {
            return DocumentError{file_, here(), "",
                                 std::string("broken XML: ") + XML_ErrorString(XML_GetErrorCode(parser))};
        }
        return std::move(points_);
    }

  private:
    static Pass& of(void* self) { return *static_cast<Pass*>(self); }

    void begin(std::string_view name, const XML_Char** attributes) {
        if (++depth_ > kDeepest) {
            fail("nested more than 64 levels deep");
            return;
        }
        // Some writers give the format's names a prefix.
        name = name.substr(name.rfind(':') + 1);
        if (pointDepth_ > 0) {
            property_ = depth_ == pointDepth_ + 1 ? name : "";
            text_.clear();
            return;
        }
        isWaypoint_ = name == "wpt";
        if (!isWaypoint_ && name != "trkpt" && name != "rtept") {
            return;
        }
        pointDepth_ = depth_;
        point_ = GpxPoints::Point();
        point_.fix.coordinate = {std::nan(""), std::nan("")};
        point_.fix.horizontalAccuracy = kOrdinaryAccuracy;
        point_.fix.verticalAccuracy = point_.fix.course = point_.fix.speed = -1.0;
        for (; *attributes != nullptr; attributes += 2) {
            const std::string_view attribute = attributes[0];
            if (attribute == "lat") {
                point_.fix.coordinate.latitude = numberOf(attributes[1]);
            } else if (attribute == "lon") {
                point_.fix.coordinate.longitude = numberOf(attributes[1]);
            }
        }
        if (!platform::isValid(point_.fix.coordinate)) {
            fail("expected a point with lat and lon in degrees");
        }
    }

    void add(std::string_view characters) {
        if (pointDepth_ > 0 && depth_ == pointDepth_ + 1 && text_.size() <= kLongestText) {
            text_ += characters.substr(0, kLongestText + 1 - text_.size());
        }
    }

    void end() {
        if (pointDepth_ > 0 && depth_ == pointDepth_ + 1) {
            take(property_, text_.size() > kLongestText ? std::nan("") : numberOf(text_));
        } else if (pointDepth_ > 0 && depth_ == pointDepth_) {
            (isWaypoint_ ? points_.waypoints : points_.track).push_back(point_);
            pointDepth_ = 0;
        }
        --depth_;
    }

    void take(std::string_view name, double number) {
        if (name == "time") {
            const auto time = documents::parseIsoTime(trimmed(text_));
            point_.time = time ? std::optional(time->date.secondsSinceReferenceDate) : std::nullopt;
        } else if (!std::isfinite(number)) {
            return;
        } else if (name == "ele") {
            point_.fix.altitude = number;
            point_.fix.verticalAccuracy = kOrdinaryAccuracy;
        } else if (name == "hdop" && number >= 0.0 && number <= kMostDilution) {
            point_.fix.horizontalAccuracy = number * kMetresAtUnitDilution;
        } else if (name == "course") {
            point_.fix.course = number;
        } else if (name == "speed") {
            point_.fix.speed = number;
        }
    }

    JsonPosition here() const {
        return {static_cast<std::size_t>(XML_GetCurrentLineNumber(parser_.get())),
                static_cast<std::size_t>(XML_GetCurrentColumnNumber(parser_.get())) + 1};
    }
    void fail(std::string message) {
        if (!error_) {
            error_ = DocumentError{file_, here(), "", std::move(message)};
            XML_StopParser(parser_.get(), XML_FALSE);
        }
    }

    const std::string& file_;
    std::unique_ptr<XML_ParserStruct, decltype(&XML_ParserFree)> parser_;
    GpxPoints points_;
    GpxPoints::Point point_;
    std::string property_;  ///< the element inside a point that is being read
    std::string text_;
    std::size_t depth_ = 0;
    std::size_t pointDepth_ = 0;  ///< of the point that is being read; 0: none is
    bool isWaypoint_ = false;
    std::optional<DocumentError> error_;
};

}  // namespace

std::variant<GpxPoints, DocumentError> GpxPoints::read(const std::string& text, const std::string& file) {
    return Pass(file).run(text);
}

}  // namespace ktr::linux_
