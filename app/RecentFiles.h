#pragma once

#include <QObject>
#include <QStringList>

namespace Orbane {

// The comps opened or saved last, newest first, kept in the application's
// QSettings so they outlive the session. A path appears once; the list keeps
// at most kMax paths.
class RecentFiles : public QObject
{
    Q_OBJECT
public:
    explicit RecentFiles(QObject *parent = nullptr);

    static constexpr int kMax = 10;

    QStringList Paths() const;
    // Puts the absolute form of `path` first.
    void Add(const QString &path);
    void Remove(const QString &path);
    void Clear();

signals:
    void changed();

private:
    void Store(const QStringList &paths);
};

} // namespace Orbane
