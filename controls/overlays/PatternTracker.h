#pragma once

#include "orbane/Types.h"

#include <QImage>
#include <QPointF>
#include <QSizeF>
#include <QString>

#include <memory>

namespace Orbane {

// Follows a pattern of pixels from frame to frame: normalised cross
// correlation of the pattern over the search area (OpenCV's template
// matching), then a parabola through the best score and its neighbours for
// the position between pixels. Positions are image pixels with (0, 0) the
// centre of the top-left pixel, Y down, as OpenCV counts them.
//
// Only the search area of each frame is turned into grey levels, so a
// frame costs about the same whatever the image's size.
class PatternTracker
{
public:
    struct Settings
    {
        QSizeF pattern{21, 21}; // pixels
        QSizeF search{61, 61};  // pixels: the area the pattern is looked for in
        bool subPixel = true;
        bool updatePattern = false; // take the pattern again from each frame found
        float64 minScore = 0.5;     // correlation below this: the pattern is lost
    };

    PatternTracker();
    ~PatternTracker();
    PatternTracker(const PatternTracker &) = delete;
    PatternTracker &operator=(const PatternTracker &) = delete;

    // Takes the pattern about `at` in `frame`. False, with the reason, where
    // the frame is empty, the pattern is larger than the frame or `at` lies
    // outside it.
    bool Start(const QImage &frame, QPointF at, const Settings &settings, QString *why = nullptr);
    // Looks for the pattern in `frame` about where it was last; false (and
    // the position unchanged) where the best match scores below the minimum
    // or lies outside the frame. `score` gets the best match's score.
    bool Step(const QImage &frame, float64 *score = nullptr);
    QPointF Position() const { return mAt; }

    // The peak of a parabola through three samples at -1, 0 and 1, as an
    // offset from the middle one (0 where they make no peak).
    static float64 ParabolaPeak(float64 left, float64 mid, float64 right) noexcept;

private:
    struct Mats;
    std::unique_ptr<Mats> mMats;
    Settings mSettings;
    QPointF mAt;
};

} // namespace Orbane
