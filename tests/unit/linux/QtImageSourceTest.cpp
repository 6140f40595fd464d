#include "linux/paint/QtImageSource.h"

#include <QFile>
#include <QPainter>
#include <QTemporaryDir>

#include "linux/device/LinuxDevice.h"
#include "linux/paint/SvgImage.h"
#include "tests/support/PlatformTest.h"
#include "tests/support/qt/Pictures.h"

namespace ktr::linux_ {

using platform::UserInterfaceIdiom;
using test::encoded;

namespace {

class QtImageSourceTest : public test::PlatformTest {
  protected:
    static std::string square(const std::string& color, int size = 10) {
        const std::string side = std::to_string(size);
        return R"(<svg xmlns="http://www.w3.org/2000/svg" width=")" + side + R"(" height=")" + side +
               R"("><rect width="100" height="100" fill=")" + color + R"("/></svg>)";
    }
    void put(const std::string& name, const std::string& content, const std::string& bundle = "org.test") {
        QDir(folder_.path()).mkpath(QString::fromStdString(bundle));
        QFile file(folder_.filePath(QString::fromStdString(bundle + "/" + name)));
        ASSERT_TRUE(file.open(QIODevice::WriteOnly));
        file.write(content.data(), static_cast<qint64>(content.size()));
    }
    QtImageSource source() { return QtImageSource(folder_.path().toStdString(), linuxDevice_); }
    static QColor colorOf(const platform::Image& image, ColorScheme scheme = ColorScheme::Light, double scale = 1.0,
                          Contrast contrast = Contrast::Normal) {
        QImage canvas(40, 40, QImage::Format_ARGB32_Premultiplied);
        canvas.fill(Qt::transparent);
        QPainter painter(&canvas);
        painter.scale(scale, scale);
        dynamic_cast<const QtImage&>(image).draw(painter, QRectF(0, 0, 10, 10), Palette::of(scheme, contrast));
        return canvas.pixelColor(3, 3);
    }

    QTemporaryDir folder_;
    std::shared_ptr<LinuxDevice> linuxDevice_ = std::make_shared<LinuxDevice>();
};

}  // namespace

TEST_F(QtImageSourceTest, NamedImage_IsTheBundlesOwn) {
    put("mark.svg", square("#ff0000", 16));
    auto found = source();
    const auto image = found.imageNamed("mark", "org.test");
    ASSERT_NE(image, nullptr);
    EXPECT_EQ(image->size(), (platform::Size{16, 16}));
    EXPECT_EQ(found.imageNamed("mark", "org.test"), image);
    EXPECT_EQ(found.imageNamed("mark", "org.other"), nullptr);
    EXPECT_EQ(found.imageNamed("none", "org.test"), nullptr);
    EXPECT_EQ(found.imageNamed("../org.test/mark", "org.test"), nullptr);
}

TEST_F(QtImageSourceTest, MissingFolder_HasNoImages) {
    QtImageSource found("/nonexistent/images", nullptr);
    EXPECT_EQ(found.imageNamed("mark", "org.test"), nullptr);
}

TEST_F(QtImageSourceTest, Appearance_IsFollowedWhileDrawing) {
    put("mark.svg", square("#ff0000"));
    put("mark~dark.svg", square("#00ff00"));
    put("mark~contrast.svg", square("#0000ff"));
    put("mark~dark~contrast.svg", square("#ffff00"));
    const auto image = source().imageNamed("mark", "org.test");
    EXPECT_EQ(colorOf(*image), QColor(Qt::red));
    EXPECT_EQ(colorOf(*image, ColorScheme::Dark), QColor(Qt::green));
    EXPECT_EQ(colorOf(*image, ColorScheme::Light, 1, Contrast::High), QColor(Qt::blue));
    EXPECT_EQ(colorOf(*image, ColorScheme::Dark, 1, Contrast::High), QColor(Qt::yellow));
}

TEST_F(QtImageSourceTest, Scale_IsTheSmallestThatIsEnough) {
    put("mark.svg", square("#ff0000"));
    put("mark@1x.svg", square("#00ff00"));
    put("mark@2x.svg", square("#0000ff"));
    const auto image = source().imageNamed("mark", "org.test");
    EXPECT_EQ(colorOf(*image, ColorScheme::Light, 1.0), QColor(Qt::green));
    EXPECT_EQ(colorOf(*image, ColorScheme::Light, 1.5), QColor(Qt::blue));
    EXPECT_EQ(colorOf(*image, ColorScheme::Light, 2.0), QColor(Qt::blue));
    EXPECT_EQ(colorOf(*image, ColorScheme::Light, 3.0), QColor(Qt::red));
}

TEST_F(QtImageSourceTest, Idiom_HasItsOwnVariantsOrThoseForAny) {
    put("mark.svg", square("#ff0000"));
    put("mark~dark.svg", square("#00ff00"));
    put("mark~display.svg", square("#0000ff"));
    auto found = source();
    EXPECT_EQ(colorOf(*found.imageNamed("mark", "org.test")), QColor(Qt::red));
    linuxDevice_->setUserInterfaceIdiom(UserInterfaceIdiom::Display);
    EXPECT_EQ(colorOf(*found.imageNamed("mark", "org.test")), QColor(Qt::blue));
    EXPECT_EQ(colorOf(*found.imageNamed("mark", "org.test"), ColorScheme::Dark), QColor(Qt::blue));
    linuxDevice_->setUserInterfaceIdiom(std::nullopt);
    EXPECT_EQ(colorOf(*found.imageNamed("mark", "org.test")), QColor(Qt::red));
}

TEST_F(QtImageSourceTest, PixelImage_TakesItsSizeFromItsScale) {
    QImage pixels(20, 30, QImage::Format_RGB32);
    pixels.fill(Qt::red);
    const auto data = encoded(pixels, "PNG");
    put("mark@2x.png", std::string(data.begin(), data.end()));
    EXPECT_EQ(source().imageNamed("mark", "org.test")->size(), (platform::Size{10, 15}));
}

TEST_F(QtImageSourceTest, FilesThatCannotBeUsed_AreLeftOutWithALine) {
    put("mark~sepia.svg", square("#ff0000"));
    put("mark@x.svg", square("#ff0000"));
    put("broken.svg", "<svg");
    put("broken.png", "no picture");
    auto found = source();
    EXPECT_EQ(found.imageNamed("mark", "org.test"), nullptr);
    EXPECT_EQ(found.imageNamed("broken", "org.test"), nullptr);
    EXPECT_TRUE(log->has(platform::LogLevel::Default, "The image broken.svg of org.test cannot be used"));
    EXPECT_TRUE(log->has(platform::LogLevel::Default, "The image mark@x.svg of org.test cannot be used"));
}

TEST_F(QtImageSourceTest, ImagesOfTheProject_AreThereForEveryIdiom) {
    QtImageSource found(std::string(KTR_SOURCE_DIR) + "/resources/images", linuxDevice_);
    for (const auto idiom : {UserInterfaceIdiom::Phone, UserInterfaceIdiom::Tablet, UserInterfaceIdiom::Desktop,
                             UserInterfaceIdiom::Display}) {
        linuxDevice_->setUserInterfaceIdiom(idiom);
        const auto icon = found.imageNamed("appIcon_dyn", "org.ktr.snippets");
        ASSERT_NE(icon, nullptr);
        EXPECT_EQ(icon->size(), (platform::Size{28, 28}));
        const auto location = found.imageNamed("location", "org.ktr.snippets");
        ASSERT_NE(location, nullptr);
        EXPECT_EQ(location->size(), (platform::Size{16, 16}));
    }
    EXPECT_TRUE(log->lines().empty());
}

TEST_F(QtImageSourceTest, LocationIndicator_IsAmberInEveryAppearance) {
    QtImageSource found(std::string(KTR_SOURCE_DIR) + "/resources/images", linuxDevice_);
    const auto image = std::dynamic_pointer_cast<QtImage>(found.imageNamed("location", "org.ktr.snippets"));
    for (const auto scheme : {ColorScheme::Light, ColorScheme::Dark}) {
        for (const auto contrast : {Contrast::Normal, Contrast::High}) {
            QImage canvas(64, 64, QImage::Format_ARGB32_Premultiplied);
            canvas.fill(Qt::transparent);
            QPainter painter(&canvas);
            const Palette& palette = Palette::of(scheme, contrast);
            image->draw(painter, QRectF(0, 0, 64, 64), palette);
            EXPECT_EQ(canvas.pixelColor(32, 40), palette.amber);
            EXPECT_EQ(canvas.pixelColor(32, 21).alpha(), 0);  // the hole
        }
    }
}

TEST_F(QtImageSourceTest, ImageFromData_HasThePicturesSize) {
    QImage pixels(30, 20, QImage::Format_RGB32);
    pixels.fill(Qt::red);
    auto found = source();
    for (const char* format : {"PNG", "JPG"}) {
        const auto image = found.imageFromData(encoded(pixels, format));
        ASSERT_NE(image, nullptr) << format;
        EXPECT_EQ(image->size(), (platform::Size{30, 20})) << format;
    }
}

TEST_F(QtImageSourceTest, ImageFromData_OfNoPictureIsNone) {
    auto found = source();
    EXPECT_EQ(found.imageFromData({}), nullptr);
    EXPECT_EQ(found.imageFromData({1, 2, 3}), nullptr);
    const std::string svg = square("#ff0000");
    EXPECT_EQ(found.imageFromData({svg.begin(), svg.end()}), nullptr);
    QImage pixels(30, 20, QImage::Format_RGB32);
    pixels.fill(Qt::red);
    auto cut = encoded(pixels, "PNG");
    cut.resize(cut.size() / 2);
    EXPECT_EQ(found.imageFromData(cut), nullptr);
}

TEST_F(QtImageSourceTest, DrawingsThatAreMoreThanThemselves_AreLeftOut) {
    QImage pixels(10, 10, QImage::Format_RGB32);
    pixels.fill(Qt::red);
    const auto data = encoded(pixels, "PNG");
    put("foreign.png", std::string(data.begin(), data.end()), "elsewhere");
    const std::string other = folder_.filePath(QStringLiteral("elsewhere/foreign.png")).toStdString();
    const std::string start =
        R"(<svg xmlns="http://www.w3.org/2000/svg" xmlns:xlink="http://www.w3.org/1999/xlink" width="10" height="10">)";
    const std::string inside = R"(<rect id="a" width="10" height="10"/><use xlink:href="#a"/></svg>)";
    put("inside.svg", start + inside);
    put("picture.svg", start + R"(<image width="10" height="10" xlink:href=")" + other + R"("/></svg>)");
    put("reference.svg", start + R"(<use xlink:href="file://)" + other + R"("/></svg>)");
    put("plain.svg", start + R"(<use href="other.svg#a"/></svg>)");
    put("type.svg", "<!DOCTYPE svg [<!ENTITY a 'x'>]>" + start + inside);
    put("huge.svg", R"(<svg xmlns="http://www.w3.org/2000/svg" width="9000" height="10"/>)");
    put("long.svg", start + "<!--" + std::string(SvgImage::kMostBytes, 'x') + "-->" + inside);
    auto found = source();
    EXPECT_NE(found.imageNamed("inside", "org.test"), nullptr);
    for (const char* name : {"picture", "reference", "plain", "type", "huge", "long"}) {
        EXPECT_EQ(found.imageNamed(name, "org.test"), nullptr) << name;
    }
}

}  // namespace ktr::linux_
