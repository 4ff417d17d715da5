#include "ui/pictureswitch.h"

#include <QBuffer>
#include <QImageReader>
#include <QPainter>

#include "settings/datafolder.h"
#include "settings/profilefile.h"
#include "ui/focusframe.h"

#include <algorithm>
#include <filesystem>
#include <optional>
#include <string>
#include <system_error>
#include <utility>

namespace kdx {

namespace {

constexpr int kPictureWidth = 32;
constexpr int kPictureHeight = 16;
constexpr std::size_t kLargestPicture = std::size_t{1024} * 1024;  // bytes; what is longer is none

/// The picture of the file that is sharpest at the width; an empty one when none can be read.
QPixmap loadPicture(const std::filesystem::path& file, int width) {
    std::optional<std::string> bytes = readFile(file);
    if (!bytes) return {};
    QBuffer buffer;
    bytes->resize(std::min(bytes->size(), kLargestPicture));
    buffer.setData(QByteArray::fromStdString(*bytes));
    buffer.open(QIODevice::ReadOnly);
    QImageReader reader(&buffer);
    QImage best;
    do {
        const QImage image = reader.read();
        if (image.isNull()) break;
        const bool enough = image.width() >= width;
        if (best.isNull() || (enough && (best.width() < width || image.width() < best.width())) ||
            (!enough && image.width() > best.width())) {
            best = image;
        }
    } while (reader.jumpToNextImage());
    return best.isNull() ? QPixmap() : QPixmap::fromImage(best);
}

}  // namespace

PictureSwitch::PictureSwitch(const DataFolder& pictures, QWidget* parent) : QAbstractButton(parent), m_data(pictures) {
    setCheckable(true);
    setFocusPolicy(Qt::StrongFocus);
    setSizePolicy(QSizePolicy::Fixed, QSizePolicy::Fixed);
}

void PictureSwitch::showState(bool on) {
    setChecked(on);
    m_pictureStale = true;
    update();
}

void PictureSwitch::tryAgain() {
    if (m_pictureStale || !m_picture.isNull()) return;
    load();  // also while its page is hidden: what is told about it holds for that too
    update();
}

void PictureSwitch::load() {
    const char* const name = isChecked() ? kPictureOn : kPictureOff;
    const auto file = m_data.file(name);
    m_picture = loadPicture(file, static_cast<int>(kPictureWidth * devicePixelRatioF()));
    m_pictureStale = false;
    std::error_code error;
    const bool broken = m_picture.isNull() && std::filesystem::exists(file, error);  // a missing one is no fault
    const QString before = std::exchange(m_brokenPicture, broken ? QString(QLatin1String(name)) : QString());
    if (m_brokenPicture != before) emit brokenPictureChanged();
}

void PictureSwitch::paintEvent(QPaintEvent* /*event*/) {
    if (m_pictureStale) load();
    QPainter painter(this);
    painter.setRenderHints(QPainter::Antialiasing | QPainter::SmoothPixmapTransform);
    if (!isEnabled()) painter.setOpacity(0.5);
    const QRect place((width() - kPictureWidth) / 2, (height() - kPictureHeight) / 2, kPictureWidth, kPictureHeight);
    if (m_picture.isNull()) {
        painter.setPen(palette().color(QPalette::WindowText));
        painter.drawRect(place.adjusted(0, 0, -1, -1));
        const QRect half =
            isChecked() ? place.adjusted(place.width() / 2, 2, -3, -3) : place.adjusted(2, 2, -place.width() / 2, -3);
        painter.fillRect(half, palette().color(isChecked() ? QPalette::Highlight : QPalette::Mid));
    } else {
        painter.drawPixmap(place, m_picture);
    }
    if (!property("zustand").toString().isEmpty()) {  // the picture hides the ground that tells it elsewhere
        painter.setPen(QPen(QColor(0xC0, 0x60, 0), 2));
        painter.drawRect(rect().adjusted(1, 1, -1, -1));
    }
    painter.end();
    paintFocus(*this);
}

}  // namespace kdx
