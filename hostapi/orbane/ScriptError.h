#pragma once

#include <string>

namespace Orbane {

// The last error a host operation reported to the script that called it.
// Host operations fail with false or null; the script layer then takes the
// message from here and raises it as a Lua error with file and line.
void SetScriptError(const std::string &message);
std::string TakeScriptError();
bool HasScriptError();

} // namespace Orbane
