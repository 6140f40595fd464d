#include "bench/KtrScene.h"

#include <QPainter>
#include <algorithm>
#include <cmath>

#include "linux/paint/QtCanvas.h"
#include "linux/paint/QtImage.h"
#include "linux/paint/QtTextEngine.h"
#include "linux/paint/ScenePainter.h"
#include "platform/assistant/AssistantSettings.h"
#include "platform/base/Log.h"
#include "platform/base/VirtualTime.h"
#include "platform/contacts/ContactAvatarController.h"
#include "platform/contacts/MonogramMaker.h"
#include "platform/ui/Appearance.h"
#include "platform/ui/Device.h"

namespace ktr::bench {

using namespace platform;

namespace {

struct BenchDevice : Device {
    std::optional<UserInterfaceIdiom> userInterfaceIdiom() const override { return UserInterfaceIdiom::Phone; }
    double mainScreenScale() const override { return 2.0; }
    ContentSizeCategory contentSizeCategory() const override { return ContentSizeCategory::L; }
};

struct BenchAssistant : AssistantSettings {
    std::optional<std::string> languageCode() const override { return "en-GB"; }
    bool languageIsRightToLeft() const override { return false; }
};

struct BenchAppearance : AssistantAppearance {
    Font lightFont(double size) const override { return {FontFace::Light, FontWeight::Regular, size}; }
    Font thinFont(double size) const override { return {FontFace::Thin, FontWeight::Regular, size}; }
    Color standardTextColor() const override { return Color::ofRole(ColorRole::StandardText); }
    Color highlightColor() const override { return Color::ofRole(ColorRole::Highlight); }
    bool isDark() const override { return false; }
    bool isHighContrast() const override { return false; }
    bool reducesMotion() const override { return false; }
};

struct SilentLog : LogSink {
    void write(const LogLine&) override {}
    bool wants(LogLevel) const override { return false; }
};

/// Initials on a disc, drawn as the floor draws them.
class Disc : public linux_::QtImage {
  public:
    Disc(QString initials, QColor color) : initials_(std::move(initials)), color_(std::move(color)) {}
    Size size() const override { return {54.0, 54.0}; }
    void draw(QPainter& painter, const QRectF& rect, const linux_::Palette&) const override {
        QFont font(QStringLiteral("Noto Sans"));
        font.setPixelSize(22);
        font.setBold(true);
        font.setHintingPreference(QFont::PreferNoHinting);
        painter.setPen(Qt::NoPen);
        painter.setBrush(color_);
        painter.drawEllipse(rect);
        painter.setFont(font);
        painter.setPen(Qt::white);
        painter.drawText(rect, Qt::AlignCenter, initials_);
    }

  private:
    QString initials_;
    QColor color_;
};

/// A contact's nickname and job title carry the initials and the colour of the file.
struct DiscAvatars : AvatarImages {
    std::shared_ptr<Image> avatarForContact(const std::shared_ptr<Contact>& contact, double) override {
        auto& disc = made[contact.get()];
        if (!disc) {
            disc = std::make_shared<Disc>(QString::fromStdString(contact ? contact->nickname : ""),
                                          QColor(QString::fromStdString(contact ? contact->jobTitle : "#7F776B")));
        }
        return disc;
    }
    std::unordered_map<const Contact*, std::shared_ptr<Image>> made;
};

}  // namespace

KtrScene::KtrScene() : palette_(linux_::Palette::of(linux_::ColorScheme::Light)) {}

KtrScene::~KtrScene() {
    clear();
}

void KtrScene::installPlatform() {
    platform_ = std::make_shared<Platform>();
    const auto time = std::make_shared<VirtualTime>(Date{790171200.0});
    platform_->logSink = std::make_shared<SilentLog>();
    platform_->mainLoop = time;
    platform_->clock = time;
    platform_->device = std::make_shared<BenchDevice>();
    platform_->assistant = std::make_shared<BenchAssistant>();
    platform_->appearance = std::make_shared<BenchAppearance>();
    platform_->avatarImages = std::make_shared<DiscAvatars>();
    platform_->textEngine = std::make_shared<linux_::QtTextEngine>(QStringLiteral("en-GB"));
    Platform::install(platform_);
}

void KtrScene::setTexts(std::size_t row, const RowTexts& texts) {
    const KTRVelaFriendView& view = *rows_[row];
    view.nameLabel()->setText(texts.name);
    view.locationLabel()->setText(texts.locality);
    view.distanceLabel()->setText(texts.distance);
    view.timeLabel()->setText(texts.age);
}

/// A fresh platform for each build: what the one before cached is no help.
void KtrScene::build(const RowsFile& file, std::size_t count, double width) {
    clear();
    installPlatform();
    file_ = &file;
    width_ = width;
    window_ = create<Window>(&View::initWithFrame, Rect{0.0, 0.0, width, 0.0});
    stack_ = create<StackView>(&View::initWithFrame, Rect{0.0, 0.0, width, 0.0});
    window_->addSubview(stack_);
    rows_.reserve(count);
    for (std::size_t i = 0; i < count; ++i) {
        auto row = create<KTRVelaFriendView>(&KTRVelaFriendView::initWithFrame, Rect{0.0, 0.0, width, 0.0});
        row->setTranslatesAutoresizingMaskIntoConstraints(false);
        auto contact = std::make_shared<Contact>();
        contact->nickname = file.friends[i].initials;
        contact->jobTitle = file.friends[i].color;
        row->avatarViewController()->setContacts({contact});
        rows_.push_back(std::move(row));
        setTexts(i, file.friends[i].now);
    }
    stack_->setArrangedSubviews({rows_.begin(), rows_.end()});
    layOut();
}

void KtrScene::layOut() {
    double height = 0.0;
    for (const auto& row : rows_) {
        height += row->estimagedHeightForView();
    }
    window_->setFrame({0.0, 0.0, width_, height});
    stack_->setFrame({0.0, 0.0, width_, height});
    window_->layoutIfNeeded();
}

void KtrScene::updateAll(bool next) {
    for (std::size_t i = 0; i < rows_.size(); ++i) {
        setTexts(i, next ? file_->friends[i].next : file_->friends[i].now);
    }
    layOut();
}

/// One row's new texts change neither the other rows' heights nor the list's: only what changed is laid out.
void KtrScene::updateOne(std::size_t row, bool next) {
    setTexts(row, next ? file_->friends[row].next : file_->friends[row].now);
    window_->layoutIfNeeded();
}

void KtrScene::resize(double width) {
    width_ = width;
    layOut();
}

double KtrScene::height() const {
    return stack_->frame().height;
}

void KtrScene::paint(QImage& image, double scale) {
    image.fill(palette_.card);
    QPainter painter(&image);
    painter.setRenderHint(QPainter::Antialiasing);
    painter.scale(scale, scale);
    linux_::QtCanvas canvas(painter, palette_);
    window_->paint(canvas, window_->bounds());
}

/// As `ktr render` does: what is too tall for one picture becomes several.
bool KtrScene::write(const QString& path, double scale) {
    const double whole = height();
    const double most = std::floor(linux_::ScenePainter::kMostPixels / scale);
    bool isGood = true;
    for (double top = 0.0; isGood && top < whole; top += most) {
        linux_::ScenePainter painter({width_, std::min(most, whole - top)}, scale, palette_);
        painter.setBackground(palette_.card);
        const QString file = top > 0.0 ? path + QString::number(top) + QStringLiteral(".png") : path;
        isGood = !painter.write(file.toStdString(), [&](linux_::QtCanvas& canvas) {
            canvas.translate(0.0, -top);
            window_->paint(canvas, canvas.seen(window_->bounds()));
        });
    }
    return isGood;
}

void KtrScene::shapeName(const std::string& name) {
    if (!platform_) {
        installPlatform();
    }
    TextContainer oneLine;
    oneLine.maximumLines = 1;
    oneLine.lineBreakMode = LineBreakMode::TruncatingTail;
    platform_->textEngine->layOut(AttributedString(name, preferredFont(TextStyle::Headline)), oneLine);
}

void KtrScene::clear() {
    rows_.clear();
    stack_.reset();
    window_.reset();
    Platform::install(nullptr);
    platform_.reset();
}

}  // namespace ktr::bench
