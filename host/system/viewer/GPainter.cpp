#include "orbane/GPainter.h"

namespace Orbane {
namespace Graphics {

// Out of line so the interface's vtable lives in liborbanesystem.
GPainter::~GPainter() = default;

void GPainter::Texture(const QImage &, const float64 *, const GColor &) {}

} // namespace Graphics
} // namespace Orbane
