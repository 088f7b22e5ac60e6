#include "tests/desktop_window/driver/ReferencePicture.h"

#include <algorithm>
#include <cstdlib>

namespace quarn::test {

namespace {

/// One pixel of a reference stands for four by four of the screen.
constexpr int REDUCTION = 4;
constexpr double GREATEST_MEAN = 0.008;
constexpr double GREATEST_SHARE = 0.02;
constexpr int VISIBLE_STEP = 255 / 10;

QImage fromSomeWayOff(const QImage& picture) {
    return picture.convertToFormat(QImage::Format_RGB32)
        .scaled(picture.size() / REDUCTION, Qt::IgnoreAspectRatio, Qt::SmoothTransformation);
}

} // namespace

PictureDifference differenceOf(const QImage& a, const QImage& b) {
    if (a.size() != b.size() || a.isNull())
        return {};
    double sum = 0.0;
    int differing = 0;
    for (int y = 0; y < a.height(); ++y)
        for (int x = 0; x < a.width(); ++x) {
            const QRgb one = a.pixel(x, y);
            const QRgb other = b.pixel(x, y);
            const int steps[] = {std::abs(qRed(one) - qRed(other)),
                                 std::abs(qGreen(one) - qGreen(other)),
                                 std::abs(qBlue(one) - qBlue(other))};
            sum += (steps[0] + steps[1] + steps[2]) / (3.0 * 255.0);
            differing += *std::ranges::max_element(steps) > VISIBLE_STEP;
        }
    const double pixels = static_cast<double>(a.width()) * a.height();
    return {sum / pixels, differing / pixels};
}

std::string compareWithReference(const QImage& picture, const QString& name) {
    const QString file =
        QString(QUARN_SOURCE_DIR "/tests/desktop_window/pictures/%1.png").arg(name);
    const QImage seen = fromSomeWayOff(picture);
    const char* const writes = std::getenv("QUARN_WRITE_PICTURES");
    if (writes && *writes)
        return seen.save(file) ? "" : "cannot write " + file.toStdString();
    const PictureDifference difference =
        differenceOf(seen, QImage(file).convertToFormat(QImage::Format_RGB32));
    if (difference.mean <= GREATEST_MEAN && difference.differing_share <= GREATEST_SHARE)
        return {};
    picture.save("other-than-" + name + ".png");
    return "mean difference " + std::to_string(difference.mean) + ", share of differing pixels " +
           std::to_string(difference.differing_share);
}

} // namespace quarn::test
