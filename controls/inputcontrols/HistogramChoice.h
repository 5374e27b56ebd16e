#pragma once

#include "widgets/Histogram.h"

#include <QObject>

class QComboBox;
class QPushButton;

namespace Orbane {

class LevelsBar;

// What the histogram controls share: a channel choice ("channel": Luma,
// Red, Green, Blue, Alpha), a log-scale switch ("scale") and the viewed
// image's histogram of that channel drawn in a LevelsBar, kept up to date
// from HistogramFeed. The children are made on the control widget given.
class HistogramChoice : public QObject
{
    Q_OBJECT
public:
    HistogramChoice(QWidget *control, LevelsBar *bar);

    QComboBox *Channels() const { return mChannels; }
    QPushButton *Scale() const { return mScale; }
    Histogram::Channel Channel() const;
    // The choice's place (luminance first), and the bars of that channel.
    void SetChoice(int index);
    void SetLogScale(bool on);
    bool IsLogScale() const;
    // Starts counting where the feed has not counted the viewed image yet.
    void Start();

signals:
    void ChannelChosen(int channel);

private slots:
    void Show();
    void OnChannelActivated(int index);

private:
    LevelsBar *mBar;
    QComboBox *mChannels;
    QPushButton *mScale;
};

} // namespace Orbane
