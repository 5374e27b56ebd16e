#pragma once

#include "orbane/Types.h"

#include <QWidget>

class QDoubleSpinBox;
class QTimer;
class QToolButton;

namespace Orbane {

class Operator;
class OrbaneDoc;
class TimeScale;

// The time ruler under the viewer: first frame, step back, play/stop, step
// forward, last frame, the current time as a field, and the scale to scrub
// on with the shown tool's key marks. Everything it does goes through the
// document's current time, which tells every bound control and overlay.
class TimeRuler : public QWidget
{
    Q_OBJECT
public:
    explicit TimeRuler(OrbaneDoc *doc, QWidget *parent = nullptr);

    TimeScale *Scale() const { return mScale; }
    void SetTool(const Operator *tool);
    void SetRange(float64 first, float64 last);

    // The buttons' gestures, also for scripts.
    void GoToFirst();
    void GoToLast();
    void Step(int frames);
    void SetPlaying(bool playing);
    bool IsPlaying() const;

    // Playback speed in frames per second.
    static constexpr int kFramesPerSecond = 24;

private slots:
    void OnTimeChanged(double time);
    void OnTick();

private:
    QToolButton *AddButton(const QString &text, const QString &name, const QString &tip);
    void SetTime(float64 time);

    OrbaneDoc *mDoc;
    TimeScale *mScale = nullptr;
    QDoubleSpinBox *mField = nullptr;
    QToolButton *mPlay = nullptr;
    QTimer *mTimer = nullptr;
};

} // namespace Orbane
