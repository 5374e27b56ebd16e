#pragma once

#include "overlays/AimedControl.h"

namespace Orbane {

// A light seen through the viewer's camera. Its Inputs go by order: 0 the
// position (a Point X, Y, Z), 1 the point it shines at (a Point), 2 a spot's
// cone angle (a Number, degrees). LC_LightType says what it is: a
// directional light draws parallel rays towards its aim, a point light a
// star (it has no aim), a spot its cone. The position knob moves it ("Move
// Light"), the aim knob moves the point it shines at ("Aim Light").
class LightControl : public AimedControl
{
public:
    enum Type : int32
    {
        LT_Directional,
        LT_Point,
        LT_Spot,
    };

    LightControl(const Registry *reg, const ScriptVal &args, const TagList &tags);

    std::size_t SizeOf() const override { return sizeof(LightControl); }
    bool GetAttrsTagList(TagList &tags) const override;
    // Adds `lightType` and `cone` (the spot's angle as drawn).
    void GetState(ScriptVal &state) const override;

    using PreviewControl::SetAttrsTagList;
    bool SetAttrsTagList(Input *input, const TagList &tags) override;

protected:
    OrbVec3 AimPoint() const override;
    bool CanAim() const override;
    void WriteAim(OrbVec3 to) override;
    void DrawGizmo(Graphics::GPainter &p, const PreviewInfo &info, const ViewCamera &view) const override;
    const char *MoveName() const override { return "Move Light"; }
    const char *AimName() const override { return "Aim Light"; }
    bool StoreMore(int32 index, const Parameter *value) override;

private:
    // Two unit vectors across the light's direction.
    void Across(OrbVec3 direction, OrbVec3 &u, OrbVec3 &v) const;
    void DrawStar(Graphics::GPainter &p, const PreviewInfo &info, const ViewCamera &view) const;
    void DrawRays(Graphics::GPainter &p, const PreviewInfo &info, const ViewCamera &view) const;
    void DrawCone(Graphics::GPainter &p, const PreviewInfo &info, const ViewCamera &view) const;

    int32 mType = LT_Directional;
    OrbVec3 mTarget;
    bool mHasTarget = false;
    float64 mCone = 30.0;
};

} // namespace Orbane
