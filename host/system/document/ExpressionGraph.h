#pragma once

#include "orbane/Parser.h"
#include "orbane/Types.h"

#include <cstddef>
#include <memory>
#include <string>
#include <unordered_map>
#include <vector>

namespace Orbane {

class Input;
class OrbaneDoc;

// The live expressions of a document's Inputs, kept in an order that
// evaluates every Input after the Inputs it reads (a topological order of
// the "reads" graph). Each expression is compiled once and bound to its own
// variables; names resolve to `time`, an Input of the same tool ("Size") or
// an Input of another tool ("Blur1.Size").
//
// Evaluated results are stored without undo: they follow from the
// expressions and the values they read, which undo does restore, and undo
// evaluates again afterwards. An expression that cannot be evaluated (an
// Input it names is gone, it is part of a cycle, its Input was animated)
// keeps its Input's value and says why on the Input.
class ExpressionGraph
{
public:
    explicit ExpressionGraph(OrbaneDoc &doc);
    ~ExpressionGraph();
    ExpressionGraph(const ExpressionGraph &) = delete;
    ExpressionGraph &operator=(const ExpressionGraph &) = delete;

    // Checks `text` as the expression of `owner` and computes its value now:
    // "" and `*value` set where it may be kept, else why it may not.
    std::string Try(const Input *owner, const char *text, float64 *value);

    // An expression was set, removed or swapped by undo: the order is built
    // again before the next evaluation.
    void Invalidate() noexcept { mDirty = true; }
    // Builds the order where it changed; expressions that could not be
    // evaluated before and can now are evaluated.
    void Settle() { EnsureBuilt(); }
    // Tools came or went: names resolve anew, and every expression follows.
    void ToolsChanged();
    // The time changed: every expression is evaluated in order.
    void TimeChanged() { EvaluateAll(); }
    // Undo swapped values and expressions: every expression follows.
    void EvaluateAll();
    // `in`'s value changed: the expressions that read it, and those that
    // read them, follow. Writes made by the graph itself do not recurse.
    void ValueChanged(const Input *in);

    std::size_t Count() const noexcept { return mOrder.size(); }

private:
    struct Node;

    void EnsureBuilt();
    void Rebuild();
    std::unique_ptr<Node> TakeOrCompile(Input *in);
    void Resolve(Node &node) const;
    void Sort();
    void MarkCycles(std::vector<Node *> &left);
    void Evaluate(Node &node);
    void SetError(Node &node, std::string error);
    // Input named by `name` as seen from `owner`'s tool, or null.
    Input *Find(const Input *owner, const std::string &name) const;

    OrbaneDoc &mDoc;
    std::unordered_map<const Input *, std::unique_ptr<Node>> mNodes;
    std::vector<Node *> mOrder; // every node that can be evaluated, readers after sources
    std::unordered_map<const Input *, std::vector<Node *>> mReaders;
    bool mDirty = true;
    bool mBusy = false;
};

} // namespace Orbane
