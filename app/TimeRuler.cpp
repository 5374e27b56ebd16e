#include "TimeRuler.h"

#include "TimeScale.h"

#include "orbane/OrbaneDoc.h"

#include <QDoubleSpinBox>
#include <QHBoxLayout>
#include <QTimer>
#include <QToolButton>

#include <algorithm>
#include <cmath>

namespace Orbane {

TimeRuler::TimeRuler(OrbaneDoc *doc, QWidget *parent) : QWidget(parent), mDoc(doc)
{
    setObjectName("timeRuler");
    auto *row = new QHBoxLayout(this);
    row->setContentsMargins(4, 2, 4, 2);
    connect(AddButton("|<", "first", tr("First frame")), &QToolButton::clicked, this, &TimeRuler::GoToFirst);
    connect(AddButton("<", "stepBack", tr("Step back")), &QToolButton::clicked, this, [this] { Step(-1); });
    mPlay = AddButton(tr("Play"), "play", tr("Play"));
    mPlay->setCheckable(true);
    connect(mPlay, &QToolButton::toggled, this, &TimeRuler::SetPlaying);
    connect(AddButton(">", "stepForward", tr("Step forward")), &QToolButton::clicked, this, [this] { Step(1); });
    connect(AddButton(">|", "last", tr("Last frame")), &QToolButton::clicked, this, &TimeRuler::GoToLast);

    mField = new QDoubleSpinBox;
    mField->setObjectName("currentTime");
    mField->setAccessibleName(tr("Current time"));
    mField->setDecimals(2);
    mField->setKeyboardTracking(false);
    row->addWidget(mField);
    mScale = new TimeScale(doc);
    row->addWidget(mScale, 1);
    SetRange(0.0, 100.0);
    connect(mField, qOverload<double>(&QDoubleSpinBox::valueChanged), this, [this](double t) { SetTime(t); });

    mTimer = new QTimer(this);
    mTimer->setInterval(1000 / kFramesPerSecond);
    connect(mTimer, &QTimer::timeout, this, &TimeRuler::OnTick);
    connect(doc, SIGNAL(currentTimeChanged(float64)), this, SLOT(OnTimeChanged(double)));
    OnTimeChanged(doc->GetCurrentTime());
}

QToolButton *TimeRuler::AddButton(const QString &text, const QString &name, const QString &tip)
{
    auto *button = new QToolButton;
    button->setText(text);
    button->setObjectName(name);
    button->setToolTip(tip);
    button->setAccessibleName(tip);
    layout()->addWidget(button);
    return button;
}

void TimeRuler::SetTool(const Operator *tool)
{
    mScale->SetTool(tool);
}

void TimeRuler::SetRange(float64 first, float64 last)
{
    mScale->SetRange(first, last);
    const QSignalBlocker block(mField);
    mField->setRange(mScale->First(), mScale->Last());
}

void TimeRuler::SetTime(float64 time)
{
    mDoc->SetCurrentTime(std::clamp(time, mScale->First(), mScale->Last()));
}

void TimeRuler::GoToFirst()
{
    SetTime(mScale->First());
}

void TimeRuler::GoToLast()
{
    SetTime(mScale->Last());
}

// Steps land on whole frames, so a step from 2.5 forward goes to 3.
void TimeRuler::Step(int frames)
{
    const float64 now = mDoc->GetCurrentTime();
    SetTime(frames > 0 ? std::floor(now) + frames : std::ceil(now) + frames);
}

void TimeRuler::SetPlaying(bool playing)
{
    if (playing == IsPlaying())
        return;
    playing ? mTimer->start() : mTimer->stop();
    const QSignalBlocker block(mPlay);
    mPlay->setChecked(playing);
    mPlay->setText(playing ? tr("Stop") : tr("Play"));
    mPlay->setToolTip(playing ? tr("Stop") : tr("Play"));
}

bool TimeRuler::IsPlaying() const
{
    return mTimer->isActive();
}

// Playback loops over the range.
void TimeRuler::OnTick()
{
    const float64 now = mDoc->GetCurrentTime();
    SetTime(now + 1.0 > mScale->Last() ? mScale->First() : now + 1.0);
}

void TimeRuler::OnTimeChanged(double time)
{
    const QSignalBlocker block(mField);
    mField->setValue(time);
}

} // namespace Orbane
