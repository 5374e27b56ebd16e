#pragma once

#include "orbane/Types.h"

#include <memory>
#include <string>
#include <vector>

namespace Orbane {

// A math expression compiled once and evaluated fast, with named variables
// ("value * 2 + minscale"). Variables are either bound to storage the caller
// owns (DefineVar) or kept by the parser (SetVar). Errors never throw: they
// make SetExpression or Evaluate fail and leave a message in GetError.
class Parser
{
public:
    Parser();
    ~Parser();
    Parser(const Parser &) = delete;
    Parser &operator=(const Parser &) = delete;

    // Binds `name` to `storage`, which must outlive the parser (or the next
    // DefineVar of the same name). False for a bad name or null storage.
    bool DefineVar(const char *name, float64 *storage);
    // Sets a variable the parser owns, defining it on first use.
    bool SetVar(const char *name, float64 value);
    // The storage bound to `name`, or null.
    float64 *GetVar(const char *name) const;

    // Compiles the expression. False (with GetError set) where it does not
    // parse or names an unknown variable; the parser then has no expression.
    bool SetExpression(const char *text);
    const char *GetExpression() const;
    bool IsValid() const noexcept;
    // The variable names `text` uses (defined or not), sorted, without
    // compiling it; false (GetError set) where it does not parse. Names may
    // hold dots ("Blur1.Size"), so an expression can name another tool's Input.
    bool UsedNames(const char *text, std::vector<std::string> &names);

    // The value with the variables as they are now. Where there is no valid
    // expression or evaluation fails: NaN, and *ok set false.
    float64 Evaluate(bool *ok = nullptr) const;
    const char *GetError() const;

private:
    struct Impl;
    std::unique_ptr<Impl> mImpl;
};

} // namespace Orbane
