#include "overlays/PatternTracker.h"

#include <opencv2/core.hpp>
#include <opencv2/imgproc.hpp>

#include <algorithm>
#include <cmath>

namespace Orbane {

namespace {

// An odd whole size of at least `least` pixels: the pattern has a middle pixel.
int OddSize(float64 pixels, int least)
{
    const int n = std::max(int(std::lround(pixels)), least);
    return n | 1;
}

// The grey levels of `frame` within `rect` (clipped to the frame), as
// floats, and where the part taken starts.
cv::Mat GreyPart(const QImage &frame, QRect rect, QPoint &origin)
{
    rect &= frame.rect();
    origin = rect.topLeft();
    if (rect.isEmpty())
        return cv::Mat();
    const QImage grey = frame.copy(rect).convertToFormat(QImage::Format_Grayscale8);
    const cv::Mat wrap(grey.height(), grey.width(), CV_8UC1, const_cast<uchar *>(grey.constBits()),
                       std::size_t(grey.bytesPerLine()));
    cv::Mat out;
    wrap.convertTo(out, CV_32F, 1.0 / 255.0);
    return out;
}

// The `size` pixels about `at` (frame pixels), read between pixels, with
// the frame's edge repeated beyond it.
cv::Mat Patch(const QImage &frame, QPointF at, cv::Size size)
{
    const int mx = size.width / 2 + 2, my = size.height / 2 + 2;
    const QRect around(int(std::floor(at.x())) - mx, int(std::floor(at.y())) - my, 2 * mx + 2, 2 * my + 2);
    QPoint origin;
    const cv::Mat part = GreyPart(frame, around, origin);
    if (part.empty())
        return cv::Mat();
    cv::Mat out;
    cv::getRectSubPix(part, size, cv::Point2f(float(at.x() - origin.x()), float(at.y() - origin.y())), out, CV_32F);
    return out;
}

bool Inside(const QImage &frame, QPointF at)
{
    return at.x() >= -0.5 && at.y() >= -0.5 && at.x() <= frame.width() - 0.5 && at.y() <= frame.height() - 0.5;
}

} // namespace

struct PatternTracker::Mats
{
    cv::Mat pattern;
};

PatternTracker::PatternTracker() : mMats(std::make_unique<Mats>()) {}

PatternTracker::~PatternTracker() = default;

float64 PatternTracker::ParabolaPeak(float64 left, float64 mid, float64 right) noexcept
{
    const float64 curve = left - 2.0 * mid + right;
    if (!(curve < 0.0))
        return 0.0;
    return std::clamp(0.5 * (left - right) / curve, -0.5, 0.5);
}

bool PatternTracker::Start(const QImage &frame, QPointF at, const Settings &settings, QString *why)
{
    auto fail = [why](const QString &reason) {
        if (why)
            *why = reason;
        return false;
    };
    if (frame.isNull())
        return fail("the frame is empty");
    const int pw = OddSize(settings.pattern.width(), 3), ph = OddSize(settings.pattern.height(), 3);
    if (pw > frame.width() || ph > frame.height())
        return fail(QString("the pattern box (%1 x %2 pixels) is larger than the image (%3 x %4)")
                        .arg(pw)
                        .arg(ph)
                        .arg(frame.width())
                        .arg(frame.height()));
    if (!Inside(frame, at))
        return fail("the tracker lies outside the image");
    mSettings = settings;
    // The search area holds the pattern with room to move on every side.
    mSettings.search =
        QSizeF(std::max(settings.search.width(), pw + 4.0), std::max(settings.search.height(), ph + 4.0));
    mMats->pattern = Patch(frame, at, cv::Size(pw, ph));
    mAt = at;
    return !mMats->pattern.empty() || fail("the pattern could not be read");
}

bool PatternTracker::Step(const QImage &frame, float64 *score)
{
    const cv::Mat &pattern = mMats->pattern;
    if (pattern.empty() || frame.isNull())
        return false;
    const cv::Size area(OddSize(mSettings.search.width(), pattern.cols),
                        OddSize(mSettings.search.height(), pattern.rows));
    const cv::Mat region = Patch(frame, mAt, area);
    if (region.empty())
        return false;
    cv::Mat result;
    cv::matchTemplate(region, pattern, result, cv::TM_CCOEFF_NORMED);
    double best = 0.0;
    cv::Point loc;
    cv::minMaxLoc(result, nullptr, &best, nullptr, &loc);
    if (score)
        *score = best;
    if (!(best >= mSettings.minScore))
        return false;
    QPointF offset(loc.x, loc.y);
    if (mSettings.subPixel) {
        auto at = [&result](int x, int y) { return float64(result.at<float>(y, x)); };
        if (loc.x > 0 && loc.x + 1 < result.cols)
            offset.rx() += ParabolaPeak(at(loc.x - 1, loc.y), best, at(loc.x + 1, loc.y));
        if (loc.y > 0 && loc.y + 1 < result.rows)
            offset.ry() += ParabolaPeak(at(loc.x, loc.y - 1), best, at(loc.x, loc.y + 1));
    }
    // The region's first pixel lies (area - 1) / 2 before the centre it was
    // read about; the pattern's middle (size - 1) / 2 into the match.
    const QPointF found = mAt - QPointF((area.width - 1) / 2.0, (area.height - 1) / 2.0) + offset +
                          QPointF((pattern.cols - 1) / 2.0, (pattern.rows - 1) / 2.0);
    if (!Inside(frame, found))
        return false;
    mAt = found;
    if (mSettings.updatePattern) {
        const cv::Mat next = Patch(frame, mAt, pattern.size());
        if (!next.empty())
            mMats->pattern = next;
    }
    return true;
}

} // namespace Orbane
