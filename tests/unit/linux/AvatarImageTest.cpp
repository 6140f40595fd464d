#include "linux/paint/AvatarImage.h"

#include <gtest/gtest.h>

#include <QBuffer>
#include <QPainter>

#include "linux/paint/PersonColors.h"
#include "linux/paint/QtAvatarImages.h"
#include "linux/paint/QtMonogramMakerFactory.h"

namespace ktr::linux_ {

using platform::Contact;
using platform::FontFace;
using platform::FontWeight;

namespace {

std::shared_ptr<Contact> contact(const std::string& given, const std::string& family, const std::string& email) {
    auto made = std::make_shared<Contact>();
    made->givenName = given;
    made->familyName = family;
    made->emailAddresses = {{"", email}};
    return made;
}

platform::Bytes png(int width, int height, const QColor& color) {
    QImage image(width, height, QImage::Format_RGB32);
    image.fill(color);
    QByteArray data;
    QBuffer buffer(&data);
    buffer.open(QIODevice::WriteOnly);
    image.save(&buffer, "PNG");
    return {data.begin(), data.end()};
}

QImage drawn(const platform::Image& image, double scale = 2.0) {
    const auto size = image.size();
    QImage canvas(static_cast<int>(size.width * scale), static_cast<int>(size.height * scale),
                  QImage::Format_ARGB32_Premultiplied);
    canvas.fill(Qt::transparent);
    QPainter painter(&canvas);
    painter.scale(scale, scale);
    dynamic_cast<const QtImage&>(image).draw(painter, QRectF(0, 0, size.width, size.height),
                                             Palette::of(ColorScheme::Light));
    return canvas;
}

/// The pixels that are nearly white.
QRect whiteArea(const QImage& image) {
    QRect area;
    for (int y = 0; y < image.height(); ++y) {
        for (int x = 0; x < image.width(); ++x) {
            if (qGray(image.pixel(x, y)) > 240) {
                area |= QRect(x, y, 1, 1);
            }
        }
    }
    return area;
}

const auto kAnn = contact("Ann", "Marsh", "ann@harbour.example");

}  // namespace

TEST(AvatarImageTest, LetterSizes_FollowTheDiameterAndShrinkToFit) {
    struct Case {
        double diameter;
        double wanted;
        double drawn;
    };
    for (const Case& c :
         {Case{42, 19, 19}, Case{54, 22, 22}, Case{58, 27, 26}, Case{72, 41, 32}, Case{89, 50, 40}, Case{89, 38, 38}}) {
        const auto image = AvatarImage::letters(c.diameter, Initials(*kAnn), Qt::blue, c.wanted);
        EXPECT_EQ(image->letterSize(), c.drawn) << c.diameter << "/" << c.wanted;
    }
    EXPECT_EQ(AvatarImage::letterSizeFor(42), 19);
    EXPECT_EQ(AvatarImage::letterSizeFor(54), 22);
    EXPECT_EQ(AvatarImage::letterSizeFor(89), 50);
    EXPECT_EQ(AvatarImage::letterSizeFor(21), 10);
    EXPECT_EQ(AvatarImage::letterSizeFor(56), 25);
}

TEST(AvatarImageTest, Letters_AreWhiteInTheMiddleOfThePersonsColour) {
    QtAvatarImages avatars;
    const QImage image = drawn(*avatars.avatarForContact(kAnn, 54), 4.0);
    EXPECT_EQ(QColor(image.pixel(image.width() / 2, 10)), PersonColors::color(8));
    EXPECT_EQ(qAlpha(image.pixel(0, 0)), 0);
    const QRect white = whiteArea(image);
    const QPoint middle = QRect(QPoint(0, 0), image.size()).center();
    EXPECT_NEAR(white.center().x(), middle.x(), 6);
    EXPECT_NEAR(white.center().y(), middle.y(), 2);
    EXPECT_LE(white.width(), 0.74 * image.width());
}

TEST(AvatarImageTest, NoContact_IsTheFigureOnStone) {
    QtAvatarImages avatars;
    const auto nobody = avatars.avatarForContact(nullptr, 54);
    const QImage image = drawn(*nobody);
    EXPECT_EQ(QColor(image.pixel(54, 8)), PersonColors::stone());
    EXPECT_EQ(QColor(image.pixel(54, 43)), QColor(Qt::white));   // the head's middle
    EXPECT_EQ(QColor(image.pixel(54, 100)), QColor(Qt::white));  // the shoulders
    EXPECT_EQ(avatars.avatarForContact(std::make_shared<Contact>(), 54), nobody);
}

TEST(AvatarImageTest, ContactWithoutALetter_IsTheFigure) {
    QtAvatarImages avatars;
    const auto image =
        std::dynamic_pointer_cast<AvatarImage>(avatars.avatarForContact(contact("", "", "a@b.example"), 54));
    EXPECT_TRUE(image->isBlank());
}

TEST(AvatarImageTest, Photo_IsCutToACircleFromItsMiddle) {
    auto person = contact("Ann", "Marsh", "ann@harbour.example");
    person->imageData = png(300, 100, Qt::red);
    QtAvatarImages avatars;
    const auto avatar = std::dynamic_pointer_cast<AvatarImage>(avatars.avatarForContact(person, 54));
    ASSERT_TRUE(avatar->isPhoto());
    EXPECT_EQ(avatar->size(), (platform::Size{54, 54}));
    const QImage image = drawn(*avatar);
    EXPECT_EQ(QColor(image.pixel(54, 54)), QColor(Qt::red));
    EXPECT_EQ(QColor(image.pixel(54, 2)), QColor(Qt::red));
    EXPECT_EQ(qAlpha(image.pixel(2, 2)), 0);
}

TEST(AvatarImageTest, PhotoThatCannotBeRead_GivesWayToTheThumbnailThenToTheLetters) {
    auto person = contact("Ann", "Marsh", "ann@harbour.example");
    person->imageData = platform::Bytes{1, 2, 3};
    QtAvatarImages avatars;
    const auto letters = std::dynamic_pointer_cast<AvatarImage>(avatars.avatarForContact(person, 54));
    EXPECT_FALSE(letters->isPhoto());
    EXPECT_EQ(letters->color(), PersonColors::color(8));
    auto other = contact("Ann", "Marsh", "ann@harbour.example");
    other->imageData = platform::Bytes{1, 2, 3};
    other->thumbnailImageData = png(10, 10, Qt::green);
    EXPECT_TRUE(std::dynamic_pointer_cast<AvatarImage>(avatars.avatarForContact(other, 54))->isPhoto());
}

TEST(AvatarImageTest, PhotoOnItsWay_ShowsTheFigure) {
    auto person = contact("Ann", "Marsh", "ann@harbour.example");
    person->imageDataAvailable = true;
    QtAvatarImages avatars;
    EXPECT_TRUE(std::dynamic_pointer_cast<AvatarImage>(avatars.avatarForContact(person, 54))->isBlank());
}

TEST(AvatarImageTest, SameContact_HasTheSameImage) {
    QtAvatarImages avatars;
    const auto image = avatars.avatarForContact(kAnn, 54);
    EXPECT_EQ(avatars.avatarForContact(kAnn, 54), image);
    EXPECT_NE(avatars.avatarForContact(kAnn, 42), image);
    // Fetched again it is another object with the same content.
    EXPECT_EQ(avatars.avatarForContact(contact("Ann", "Marsh", "ann@harbour.example"), 54), image);
    EXPECT_NE(avatars.avatarForContact(contact("Ann", "Marsh", "l.haddad@mail.example"), 54), image);
    for (int i = 0; i < 1000; ++i) {
        avatars.avatarForContact(contact("Ann", "Marsh", std::to_string(i) + "@b.example"), 54);
    }
    EXPECT_NE(avatars.avatarForContact(kAnn, 54), image);  // forgotten: the store is bounded
}

TEST(QtMonogramMakerTest, Font_DecidesTheSize) {
    QtMonogramMakerFactory factory;
    const auto maker = factory.makeMonogramMaker(1, 89);
    const auto sizeOf = [&] {
        return std::dynamic_pointer_cast<AvatarImage>(maker->monogramForContact(*kAnn))->letterSize();
    };
    EXPECT_EQ(sizeOf(), 40);
    maker->setFont({FontFace::Rounded, FontWeight::Semibold, 38});
    EXPECT_EQ(sizeOf(), 38);
    EXPECT_EQ(maker->monogramForContact(*kAnn)->size(), (platform::Size{89, 89}));
}

TEST(QtMonogramMakerTest, Tint_MakesAnotherMaker) {
    QtMonogramMakerFactory factory;
    const auto maker = factory.makeMonogramMaker(1, 89);
    const auto tinted = maker->makerTintedWith(platform::Color::rgb(1, 0, 0));
    const auto colorOf = [](platform::MonogramMaker& made) {
        return std::dynamic_pointer_cast<AvatarImage>(made.monogramForContact(*kAnn))->color();
    };
    EXPECT_EQ(colorOf(*maker), PersonColors::color(8));
    EXPECT_EQ(colorOf(*tinted), QColor(Qt::red));
    EXPECT_TRUE(std::dynamic_pointer_cast<AvatarImage>(tinted->monogramForContact(Contact()))->isBlank());
}

TEST(QtMonogramMakerTest, ContactWithAPhoto_HasTheRowsFace) {
    const auto faces = std::make_shared<QtAvatarImages>();
    QtMonogramMakerFactory factory(faces);
    auto ann = contact("Ann", "Marsh", "ann@harbour.example");
    ann->thumbnailImageData = png(30, 30, Qt::red);
    const auto monogramOf = [&](const Contact& one) {
        return std::dynamic_pointer_cast<AvatarImage>(factory.makeMonogramMaker(1, 89)->monogramForContact(one));
    };
    const auto face = monogramOf(*ann);
    ASSERT_NE(face, nullptr);
    EXPECT_TRUE(face->isPhoto());
    EXPECT_EQ(monogramOf(*ann), face) << "decoded once";
    EXPECT_EQ(faces->avatarForContact(ann, 89), face) << "and for rows of its size too";
    ann->thumbnailImageData = platform::Bytes{1, 2, 3};
    EXPECT_FALSE(monogramOf(*ann)->isPhoto()) << "one that cannot be read gives way to the letters";
    EXPECT_GT(monogramOf(*ann)->letterSize(), 0.0);
}

TEST(QtMonogramMakerTest, DiameterOfNone_DrawsNothing) {
    QtMonogramMakerFactory factory;
    const auto image = factory.makeMonogramMaker(1, 0)->monogramForContact(*kAnn);
    ASSERT_NE(image, nullptr);
    QImage canvas(10, 10, QImage::Format_ARGB32_Premultiplied);
    canvas.fill(Qt::transparent);
    QPainter painter(&canvas);
    dynamic_cast<const QtImage&>(*image).draw(painter, QRectF(0, 0, 10, 10), Palette::of(ColorScheme::Light));
    EXPECT_EQ(canvas.pixel(5, 5), 0U);
}

}  // namespace ktr::linux_
