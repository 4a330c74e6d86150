#pragma once

#include <QObject>

/// Tells a key that is held from one that is pressed again and again.
///
/// For a held key the X server sends a release and a press of one and the same time; Qt's own mark needs to see both at
/// once, and under load it often does not.
class HeldKey final : public QObject {
public:
    /// Begins to watch; to be called before keys are asked about.
    static void watch() { instance(); }
    /// Whether the key that was pressed last repeats itself.
    static bool isRepeating() { return instance().isRepeating_; }

protected:
    bool eventFilter(QObject* receiver, QEvent* event) override;

private:
    HeldKey();
    static HeldKey& instance();

    quint64 released_ = 0; // when a key was released last, in milliseconds; 0 where events have no time
    bool isRepeating_ = false;
};
