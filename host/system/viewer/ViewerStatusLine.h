#pragma once

#include "orbane/ViewerImageState.h"

#include <QString>

class QPainter;
class QRect;

namespace Orbane {

// The line at the foot of the viewer that says how far a read has come (with
// a bar) or why the picture is not what was asked for. Nothing is drawn when
// all is well.
class ViewerStatusLine
{
public:
    // The words shown; empty where there is nothing to say.
    static QString Text(const ViewerImageState &state);
    static void Paint(QPainter &p, const QRect &viewer, const ViewerImageState &state);
};

} // namespace Orbane
