#pragma once

#include "orbane/OrbPointT.h"
#include "orbane/Types.h"

#include <Qt>

#include <optional>
#include <vector>

namespace Orbane {

// The angle overlay's mappings, free of any viewer or painter so that each
// can be checked on its own: mouse to angle, the continuous angle across
// turns, ring distance, the radius, key steps and the dial's shape.
//
// Angles are degrees, counter-clockwise from the X axis. Directions are
// either aspect-corrected image units (lengths in image widths as shown, the
// same on screen along both axes) or viewer units; both are round on screen,
// so an angle reads the same in either.
class AngleGeometry
{
public:
    // Radius of the dial's ring, in handle pixels; the ring is what a press
    // of dial style 1 grabs.
    static constexpr float64 RingRadius = 50.0;
    // Half-width of the band around the ring (or the arm's end) that a press
    // grabs at least, in handle pixels.
    static constexpr float64 GrabReach = 4.0;
    // A direction whose X is within this of 0 (aspect-corrected image units)
    // is straight up or down: atan would be too touchy there.
    static constexpr float64 VerticalBand = 0.0005;
    // A drag that turns the angle by no more than this writes nothing.
    static constexpr float64 MinTurn = 0.01;
    // The radius is finer than positions: it is stored on a change above this.
    static constexpr float64 RadiusThreshold = 1e-6;
    // Added before the modulo of the current angle, so that fmod stays
    // positive for angles down to -360000 degrees, the designed range.
    static constexpr float64 TurnBias = 360000.0;

    // The drag's direction of `d`: 90 or 270 inside the vertical band, else
    // atan(d.y / d.x) brought into [0, 360).
    static float64 DragDirection(OrbPoint d) noexcept;
    // The press's direction of `d`: atan(d.y / d.x), ±90 by the sign of d.y
    // when d.x is 0, 180 more when d.x is negative. Not brought into range:
    // only its difference to the angle is kept.
    static float64 PressDirection(OrbPoint d) noexcept;
    // The shortest turn from `current` to the direction `target`: about
    // [-180, 180], with C's sign-keeping fmod throughout (an angle below
    // -TurnBias turns by up to a whole turn: outside the designed range).
    static float64 Turn(float64 target, float64 current) noexcept;
    // The angle a drag writes: `angle` turned towards `target` from
    // `current` (the grabbed direction), or nothing where the turn is at
    // most MinTurn or the result is not a finite, different number.
    static std::optional<float64> Dragged(float64 angle, float64 target, float64 current) noexcept;

    // The effective radius: the larger of `minRadius` and value × scale; a
    // part that is not a number gives way to the other.
    static float64 Radius(float64 minRadius, float64 value, float64 scale) noexcept;
    // Does `a` differ from `b` by more than `threshold`? A NaN differs from a
    // number and equals another NaN, so a copy that compares this way never
    // takes the same NaN twice and never misses a change to or from one.
    static bool Differs(float64 a, float64 b, float64 threshold) noexcept;

    // How far `mouse` is from the ring of `radius` around `centre`.
    static float64 RingDistance(OrbPoint mouse, OrbPoint centre, float64 radius) noexcept;
    // The grab tolerance of a press: the pick tolerance, at least the whole
    // part of GrabReach handle pixels. Hover tests take the exact reach.
    static float64 PressTolerance(int32 pickTolerance, float64 handleScale) noexcept;
    static float64 HoverTolerance(int32 pickTolerance, float64 handleScale) noexcept;

    // The end of the radius arm, in image coordinates: `radius` image widths
    // from `centre` at `degrees`, Y stretched by `yPerX` (the aspect's Y
    // units per X unit) so that the arm is as long on screen either way.
    static OrbPoint ArmEnd(OrbPoint centre, float64 degrees, float64 radius, float64 yPerX) noexcept;
    // The grab offset of a press at `mouse` on the ring of `radius` about
    // `centre` (viewer units): the ring's point in the mouse's direction,
    // less the mouse. Its length is the mouse's distance from the ring.
    static OrbPoint RingGrab(OrbPoint mouse, OrbPoint centre, float64 radius) noexcept;
    // The unit direction of `degrees`, reduced first so that huge angles
    // keep their precision.
    static OrbPoint UnitAt(float64 degrees) noexcept;
    // The unit direction of `v`; the X axis for a null or unusable vector.
    static OrbPoint UnitOf(OrbPoint v) noexcept;

    // The angle an arrow key adds: Left +1 (counter-clockwise), Right -1,
    // ten with Shift, a tenth with Control; 0 for any other key.
    static float64 KeyStep(int key, Qt::KeyboardModifiers mods) noexcept;
    static bool IsAngleKey(uint64 key) noexcept { return key == Qt::Key_Left || key == Qt::Key_Right; }

    // The dial in handle pixels about its centre. Its ring: RingPoints points
    // of a closed loop, counter-clockwise from the X axis, the same for every
    // dial. Its lines, in pairs: the arm at `degrees` (none where that is no
    // number), the centre cross and the quarter marks. Only dial style 1 has
    // lines; the ring belongs to it too.
    static constexpr int32 RingPoints = 48;
    static std::vector<OrbPoint> RingLoop();
    static std::vector<OrbPoint> DialLines(int32 style, float64 degrees);
    static bool DrawsDial(int32 style) noexcept { return style == 1; }
};

} // namespace Orbane
