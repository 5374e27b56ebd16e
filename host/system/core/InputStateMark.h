#pragma once

#include <QWidget>

namespace Orbane {

class Input;
class Parameter;

// What an inspector control tells beyond its own face: a thin strip at its
// left edge, tinted while the Input is animated and lit where a key sits at
// the current time, and the accessible name and value (the Input's name and
// its value in words) that screen readers and UI test tools read.
class InputStateMark : public QWidget
{
    Q_OBJECT
public:
    enum class State
    {
        Plain,    // no animation: the strip is hidden
        Animated, // between keys
        OnKey,    // a key at the current time
    };

    // Brings `control`'s mark and accessible texts up to date for `input`
    // showing `value` (null: read it at the current time), making the mark
    // on the first animated value.
    static void Update(QWidget *control, const Input *input, const Parameter *value = nullptr);
    static State StateOf(const Input *input);
    // A value in words ("0.5", "0.25, 0.75", the text); else its type.
    static QString ValueText(const Parameter *value);

    State GetState() const { return mState; }

    static constexpr int kWidth = 3;

protected:
    void paintEvent(QPaintEvent *event) override;

private:
    explicit InputStateMark(QWidget *control);
    void SetState(State state);

    State mState = State::Plain;
};

} // namespace Orbane
