#pragma once

namespace Orbane {

class OrbaneDoc;

// Script functions for live expressions on Inputs: SetExpression,
// GetExpression and ExpressionError. docs/scripting.md describes them.
class ExpressionScripting
{
public:
    static void Install(OrbaneDoc *doc);
};

} // namespace Orbane
