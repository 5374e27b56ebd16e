#pragma once

#include "orbane/AutoParam.h"
#include "orbane/InputWatcher.h"

#include <functional>
#include <limits>
#include <string>
#include <vector>

namespace Orbane {

// A watcher that writes down every call, and can run something in reply.
class RecordingWatcher : public InputWatcher
{
public:
    struct Call
    {
        std::string who;
        Input *in;
        AutoParameter value;
        const TagList *tags;
    };

    RecordingWatcher(std::string name, std::vector<Call> &log) : mName(std::move(name)), mLog(log) {}

    void OnInputChanged(Input *in, Parameter *value, const TagList *tags) override
    {
        mLog.push_back({mName, in, AutoParameter(AutoRef<Parameter>::Share(value)), tags});
        if (OnCall)
            OnCall(in, value);
    }

    std::function<void(Input *, Parameter *)> OnCall;

private:
    std::string mName;
    std::vector<Call> &mLog;
};

// The number an Input holds at `time`, or NaN where it holds none.
inline float64 NumberAt(Input *in, float64 time)
{
    AutoNumber n(in, time);
    return n ? n->Value : std::numeric_limits<float64>::quiet_NaN();
}

} // namespace Orbane
