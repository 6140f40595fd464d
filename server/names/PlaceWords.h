#pragma once

#include <memory>
#include <string>

#include "server/names/ViewerLocale.h"

namespace ktr::server {

/// Words where somebody is, in a viewer's language and with the units of their region: those of road signs, as clients
/// word distances. One thread at a time.
class PlaceWords {
  public:
    explicit PlaceWords(const ViewerLocale& locale);
    ~PlaceWords();
    PlaceWords(const PlaceWords&) = delete;
    PlaceWords& operator=(const PlaceWords&) = delete;

    /// In which names are wanted (BCP 47): the viewer's, or English where there are no texts in it.
    const std::string& language() const { return language_; }
    /// "Quay Road, Brinmouth"; the street alone where the town is not known.
    std::string street(const std::string& street, const std::string& town) const;
    /// "near Exeter, 40 km".
    std::string near(const std::string& town, double metres) const;
    /// "50.21° north, 3.12° west".
    std::string coordinates(double latitude, double longitude) const;

  private:
    struct Formats;

    std::string distance(double metres) const;
    std::string degrees(double value, const char* positive, const char* negative) const;
    std::string text(const char* key, std::initializer_list<std::string> arguments) const;

    std::string tag_;  ///< of the texts
    std::string language_;
    std::unique_ptr<Formats> formats_;
};

}  // namespace ktr::server
