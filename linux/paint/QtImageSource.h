#pragma once

#include <map>
#include <memory>
#include <string>
#include <utility>
#include <vector>

#include "linux/paint/NamedImage.h"
#include "platform/ui/Device.h"
#include "platform/ui/Image.h"

namespace ktr::linux_ {

/// Named images from a resource folder, and images from data. The folder holds a folder for each bundle, named by its
/// identifier, and in it a file for each variant (see NamedImage::Variant for their names). All of it is read when the
/// source is made; later nothing is read. Main thread, while a QGuiApplication exists.
class QtImageSource final : public platform::ImageSource {
  public:
    /// `device` decides the idiom; without one images for no particular idiom are given. A folder that is missing has
    /// no images; a file that cannot be read is left out with a log line.
    QtImageSource(const std::string& folder, std::shared_ptr<platform::Device> device);

    /// An idiom's own variants replace the others altogether. The same name gives the same object.
    std::shared_ptr<platform::Image> imageNamed(const std::string& name, const std::string& bundleIdentifier) override;
    std::shared_ptr<platform::Image> imageFromData(const platform::Bytes& data) override;

  private:
    using Key = std::pair<std::string, std::string>;  // bundle, name

    void readBundle(const QString& folder, const std::string& bundle);

    std::shared_ptr<platform::Device> device_;
    std::map<Key, std::vector<NamedImage::Variant>> variants_;
    std::map<std::pair<Key, int>, std::shared_ptr<NamedImage>> images_;
};

}  // namespace ktr::linux_
