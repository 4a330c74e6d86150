#include "platform/MessageRunner.h"

#include "platform/Looper.h"
#include "platform/Message.h"

#include <QTimer>

#include <algorithm>
#include <limits>

BMessageRunner::BMessageRunner(const BMessenger& target, const BMessage* message, bigtime_t interval)
    : timer_(std::make_unique<QTimer>())
{
    QObject::connect(timer_.get(), &QTimer::timeout, [target, sent = *message] {
        BHandler* handler = target.Target();
        BLooper* looper = handler != nullptr ? handler->Looper() : nullptr;
        BMessage copy = sent;
        if (looper != nullptr)
            looper->DispatchMessage(&copy, handler);
    });
    SetInterval(interval);
}

BMessageRunner::~BMessageRunner() = default;

void BMessageRunner::SetInterval(bigtime_t interval)
{
    constexpr bigtime_t kMicroseconds = 1000; // a millisecond, of which Qt counts as many as an int holds
    timer_->start(
        static_cast<int>(std::clamp<bigtime_t>(interval / kMicroseconds, 1, std::numeric_limits<int>::max())));
}
