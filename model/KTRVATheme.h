#pragma once

#include <memory>
#include <string>

#include "platform/ui/Color.h"
#include "platform/ui/Font.h"
#include "platform/ui/Image.h"

namespace ktr {

/// Where the rows take their fonts, colours and images from, so that all of them follow the assistant's own look. Sizes
/// in points. Main thread.
class KTRVATheme {
  public:
    static platform::Font friendNameFont();              ///< light, 18
    static platform::Font distanceFont();                ///< light, 18
    static platform::Font friendLocationFont();          ///< light, 14
    static platform::Font friendTimeFont();              ///< light, 14
    static platform::Font geoFenceFriendLocationFont();  ///< thin, 14
    static platform::Font showAllFont();                 ///< thin, 18

    static platform::Color friendNameTextColor();       ///< the standard text colour
    static platform::Color distanceTextColor();         ///< the standard text colour
    static platform::Color friendLocationTextColor();   ///< the standard text colour
    static platform::Color distanceColor();             ///< the standard text colour
    static platform::Color distanceShadowColor();       ///< black at alpha 0.5
    static platform::Color selectionBackgroundColor();  ///< the highlight colour
    static platform::Color ktrOrangeColor();            ///< 239, 143, 20 of 255 each, in single precision

    /// The variant of the named image of the plugin's own bundle that fits the device, or none.
    static std::shared_ptr<platform::Image> themeImageNamed(const std::string& name);
    /// The image "location"; once found it is kept, while a failed lookup is tried again on the next call.
    static std::shared_ptr<platform::Image> locationIndicator();
};

}  // namespace ktr
