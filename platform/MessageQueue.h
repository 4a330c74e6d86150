#pragma once

#include "platform/Message.h"

#include <QObject>

#include <cstdint>

class BHandler;
class BLooper;

/// Carries posted messages through Qt's event loop, in the order in which they were posted.
class MessageQueue final : public QObject {
public:
    static void post(const BMessage& message, BLooper& looper, BHandler& handler);

protected:
    bool event(QEvent* event) override;
};
