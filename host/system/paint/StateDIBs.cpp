#include "orbane/StateDIBs.h"

#include "orbane/DIB.h"

#include <string>

namespace Orbane {

StateDIBs::~StateDIBs()
{
    for (int32 i = 0; i < MaxStates; ++i)
        SetState(i, nullptr);
}

StateDIBs *StateDIBs::FromResource(const char *base, qreal ratio)
{
    if (!base)
        return nullptr;
    StateDIBs *states = nullptr;
    for (int32 i = 0; i < MaxStates; ++i) {
        DIB *image = DIB::FromResource((std::string(base) + '.' + std::to_string(i + 1)).c_str(), ratio);
        if (!image)
            break;
        if (!states)
            states = new StateDIBs;
        states->SetState(i, image);
        image->Recycle();
    }
    return states;
}

void StateDIBs::SetState(int32 state, DIB *image)
{
    if (state < 0 || state >= MaxStates)
        return;
    if (image)
        image->Use();
    if (mStates[state])
        mStates[state]->Recycle();
    mStates[state] = image;
}

DIB *StateDIBs::GetState(int32 state) const noexcept
{
    return state >= 0 && state < MaxStates ? mStates[state] : nullptr;
}

int32 StateDIBs::Count() const noexcept
{
    for (int32 i = MaxStates; i > 0; --i)
        if (mStates[i - 1])
            return i;
    return 0;
}

} // namespace Orbane
