#include "orbane/GPainter.h"

namespace Orbane {
namespace Graphics {

// Out of line so the interface's vtable lives in liborbanesystem.
GPainter::~GPainter() = default;

} // namespace Graphics
} // namespace Orbane
