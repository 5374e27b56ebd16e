#include "inputcontrols/HistogramChoice.h"

#include "widgets/HistogramFeed.h"
#include "widgets/LevelsBar.h"

#include <QComboBox>
#include <QPushButton>

namespace Orbane {

namespace {

// The order of the choice: luminance first, as the curves list them.
const Histogram::Channel kOrder[] = {Histogram::Luma, Histogram::Red, Histogram::Green, Histogram::Blue,
                                     Histogram::Alpha};
const char *const kNames[] = {"Luma", "Red", "Green", "Blue", "Alpha"};
const QColor kColours[] = {
    {200, 200, 200, 150}, {235, 80, 70, 170}, {90, 200, 90, 170}, {90, 140, 240, 170}, {170, 170, 170, 150}};

} // namespace

HistogramChoice::HistogramChoice(QWidget *control, LevelsBar *bar)
    : QObject(control), mBar(bar), mChannels(new QComboBox(control)), mScale(new QPushButton("Log", control))
{
    for (const char *name : kNames)
        mChannels->addItem(name);
    mChannels->setObjectName("channel");
    mScale->setObjectName("scale");
    mScale->setCheckable(true);
    mScale->setChecked(true);
    connect(mChannels, SIGNAL(activated(int)), this, SLOT(OnChannelActivated(int)));
    connect(mScale, SIGNAL(toggled(bool)), this, SLOT(Show()));
    connect(&HistogramFeed::Instance(), SIGNAL(Updated()), this, SLOT(Show()));
    Show();
}

Histogram::Channel HistogramChoice::Channel() const
{
    return kOrder[std::clamp(mChannels->currentIndex(), 0, 4)];
}

void HistogramChoice::SetChoice(int index)
{
    mChannels->setCurrentIndex(std::clamp(index, 0, 4));
    Show();
}

void HistogramChoice::SetLogScale(bool on)
{
    mScale->setChecked(on);
}

bool HistogramChoice::IsLogScale() const
{
    return mScale->isChecked();
}

void HistogramChoice::Start()
{
    HistogramFeed::Instance().Refresh();
}

void HistogramChoice::Show()
{
    const auto histogram = HistogramFeed::Instance().Current();
    mBar->SetHistogram(histogram->Heights(Channel(), IsLogScale()),
                       kColours[std::clamp(mChannels->currentIndex(), 0, 4)]);
}

void HistogramChoice::OnChannelActivated(int)
{
    Show();
    emit ChannelChosen(int(Channel()));
}

} // namespace Orbane
