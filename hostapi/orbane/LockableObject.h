#pragma once

#include <QReadWriteLock>

namespace Orbane {

// A read/write lock for host objects that other threads may look at (an
// Input's list of attached controls). Recursive, so that code already reading
// may read again; never take the write lock while holding the read lock.
class LockableObject
{
public:
    LockableObject() : mLock(QReadWriteLock::Recursive) {}
    LockableObject(const LockableObject &) = delete;
    LockableObject &operator=(const LockableObject &) = delete;

    void ReadLock() const { mLock.lockForRead(); }
    void ReadUnlock() const { mLock.unlock(); }
    void WriteLock() const { mLock.lockForWrite(); }
    void WriteUnlock() const { mLock.unlock(); }
    // The names controls use for the read side.
    void ObtainReadLock() const { ReadLock(); }
    void ReleaseReadLock() const { ReadUnlock(); }

    // Holds the read lock for one scope.
    class ReadGuard
    {
    public:
        explicit ReadGuard(const LockableObject &o) : mObj(o) { mObj.ReadLock(); }
        ~ReadGuard() { mObj.ReadUnlock(); }
        ReadGuard(const ReadGuard &) = delete;
        ReadGuard &operator=(const ReadGuard &) = delete;

    private:
        const LockableObject &mObj;
    };

    // Holds the write lock for one scope.
    class WriteGuard
    {
    public:
        explicit WriteGuard(const LockableObject &o) : mObj(o) { mObj.WriteLock(); }
        ~WriteGuard() { mObj.WriteUnlock(); }
        WriteGuard(const WriteGuard &) = delete;
        WriteGuard &operator=(const WriteGuard &) = delete;

    private:
        const LockableObject &mObj;
    };

protected:
    ~LockableObject() = default;

private:
    mutable QReadWriteLock mLock;
};

} // namespace Orbane
