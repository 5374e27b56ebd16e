#include "orbane/ClipSequence.h"

#include <QDir>
#include <QFileInfo>
#include <QRegularExpression>

#include <algorithm>

namespace Orbane {

namespace {

// Where the frame sits in a file name: the last run of digits or of '#'.
bool FindFrameRun(const QString &name, int *start, int *length)
{
    static const QRegularExpression run("(\\d+|#+)(?!.*(\\d|#))");
    const QRegularExpressionMatch m = run.match(name);
    if (!m.hasMatch())
        return false;
    *start = m.capturedStart(1);
    *length = m.capturedLength(1);
    return true;
}

// "plate.%04d.exr" -> "plate.####.exr", "plate.%d.exr" -> "plate.#.exr": the
// last printf field of the name as '#'s, so one frame finder serves both.
QString HashesForPrintf(const QString &name)
{
    static const QRegularExpression field("%0?(\\d*)d(?!.*%0?\\d*d)");
    const QRegularExpressionMatch m = field.match(name);
    if (!m.hasMatch())
        return name;
    const int width = std::clamp(m.captured(1).toInt(), 1, 10); // an int32 frame has at most 10 digits
    return QString(name).replace(m.capturedStart(0), m.capturedLength(0), QString(width, '#'));
}

// Does a run of digits stand for a frame of `padding` digits?
bool FitsPadding(const QString &digits, int padding)
{
    return digits.size() == padding || (digits.size() > padding && digits[0] != '0');
}

} // namespace

bool ClipSequence::HasFrame(int32 frame) const
{
    return std::binary_search(frames.begin(), frames.end(), frame);
}

int32 ClipSequence::HeldFrame(int32 frame) const
{
    if (frames.empty())
        return frame;
    const auto after = std::upper_bound(frames.begin(), frames.end(), frame);
    return after == frames.begin() ? frames.front() : *(after - 1);
}

QString ClipSequence::FrameFile(int32 frame) const
{
    if (!IsSequence())
        return pattern;
    int start = 0, length = 0;
    const QFileInfo info(pattern);
    QString name = info.fileName();
    if (!FindFrameRun(name, &start, &length))
        return pattern;
    name.replace(start, length, QString::number(frame).rightJustified(padding, '0'));
    return info.dir().filePath(name);
}

QString ClipSequence::Describe() const
{
    if (IsEmpty())
        return "no frames found";
    if (!IsSequence())
        return "still image";
    QString text = QString("%1-%2 (%3 frames)").arg(first).arg(last).arg(count);
    if (Gaps() > 0)
        text += QString(", %1 missing").arg(Gaps());
    return text;
}

ClipSequence ClipSequence::Detect(const QString &path)
{
    ClipSequence clip;
    clip.pattern = path;
    const QFileInfo info(path);
    const QString name = HashesForPrintf(info.fileName());
    int start = 0, length = 0;
    if (!FindFrameRun(name, &start, &length)) {
        clip.count = info.isFile() ? 1 : 0;
        clip.first = clip.last = 0;
        return clip;
    }
    const QString head = name.left(start), tail = name.mid(start + length);
    clip.padding = length;
    clip.pattern = info.dir().filePath(head + QString(length, '#') + tail);
    const QStringList files =
        info.dir().entryList({head + "*" + tail}, QDir::Files | QDir::Readable | QDir::NoDotAndDotDot);
    for (const QString &file : files) {
        const QString digits = file.mid(head.size(), file.size() - head.size() - tail.size());
        bool ok = false;
        const int32 frame = digits.toInt(&ok);
        if (!ok || !FitsPadding(digits, length) || digits.contains(QRegularExpression("\\D")))
            continue;
        clip.frames.push_back(frame);
    }
    // The folder lists names in text order: "10" before "9" where unpadded.
    std::sort(clip.frames.begin(), clip.frames.end());
    clip.count = int32(clip.frames.size());
    if (clip.count) {
        clip.first = clip.frames.front();
        clip.last = clip.frames.back();
    }
    return clip;
}

bool ClipSequence::IsPattern(const QString &path)
{
    const QString name = QFileInfo(path).fileName();
    return name.contains('#') || HashesForPrintf(name) != name;
}

} // namespace Orbane
