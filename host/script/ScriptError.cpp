#include "orbane/ScriptError.h"

namespace Orbane {

namespace {

// One message per thread, so that a worker's failure never reaches the
// script running on the UI thread.
std::string &Pending()
{
    thread_local std::string message;
    return message;
}

} // namespace

void SetScriptError(const std::string &message)
{
    Pending() = message;
}

std::string TakeScriptError()
{
    std::string message;
    message.swap(Pending());
    return message;
}

bool HasScriptError()
{
    return !Pending().empty();
}

} // namespace Orbane
