#include "app/NoticeLine.h"

#include "chart/ChartText.h"
#include "platform/Button.h"
#include "platform/Message.h"
#include "platform/MessageRunner.h"
#include "platform/Window.h"
#include "views/Look.h"

#include <algorithm>
#include <cmath>
#include <utility>

namespace {

constexpr uint32 kExpired = 'NtEx';
constexpr uint32 kKeyPressed = 'NtKy';
constexpr uint32 kDismissed = 'NtDs';
constexpr bigtime_t kPassingTime = 6000000;
constexpr std::chrono::seconds kTogether(1);
constexpr rgb_color kEdge = {204, 178, 104, 255};
constexpr float kInset = 8;     // of the text
constexpr float kEdgeWidth = 2; // about a button

} // namespace

/// The text of a notice, shortened to the room there is. A click goes on to the line.
class NoticeText final : public BView {
public:
    explicit NoticeText(BRect frame) : BView(frame, "txtNotice", B_FOLLOW_LEFT | B_FOLLOW_TOP, B_WILL_DRAW)
    {
        SetViewColor(B_TRANSPARENT_COLOR);
    }

    void setText(const std::string& text)
    {
        text_ = text;
        std::ranges::replace(text_, '\n', ' ');
        SetAccessibleName(text.c_str());
        SetToolTip(text.empty() ? "" : (text + "\n(A click dismisses this, or Alt+0)").c_str());
        Invalidate();
    }

    void Draw(BRect) override
    {
        BFont font;
        GetFont(&font);
        font_height height;
        font.GetHeight(&height);
        const BRect bounds = Bounds();
        const TextWidth width = [this](const std::string& text) { return StringWidth(text.c_str()); };
        DrawString(fitText(text_, width, bounds.Width()).c_str(),
                   {0, std::round((bounds.Height() + height.ascent - height.descent) / 2)});
    }

    void MouseDown(BPoint where) override { Parent()->MouseDown(where); }

private:
    std::string text_;
};

NoticeLine::NoticeLine(BRect frame) : BView(frame, "NoticeLine", B_FOLLOW_LEFT | B_FOLLOW_BOTTOM, B_WILL_DRAW)
{
    SetViewColor(look::kNotice);
    const float height = frame.Height();
    AddChild(text_ = new NoticeText({kInset, 0, frame.Width() - kInset, height}));
    for (const auto& [name, key] :
         {std::pair("btnNotice1", "Alt+6"), {"btnNotice2", "Alt+7"}, {"btnNotice3", "Alt+8"}}) {
        buttons_.push_back(new BButton({0, kEdgeWidth, 0, height - kEdgeWidth}, name, "", nullptr, B_WILL_DRAW));
        buttons_.back()->SetToolTip(key);
        AddChild(buttons_.back());
    }
    Hide();
}

NoticeLine::~NoticeLine() = default;

void NoticeLine::AttachedToWindow()
{
    for (int32 button = 0; button < static_cast<int32>(buttons_.size()); ++button) {
        auto* message = new BMessage(kKeyPressed);
        message->AddInt32("button", button);
        Window()->AddShortcut('6' + static_cast<uint32>(button), B_COMMAND_KEY, message, this);
    }
    Window()->AddShortcut('0', B_COMMAND_KEY, new BMessage(kDismissed), this);
}

void NoticeLine::MessageReceived(BMessage* message)
{
    int32 button = 0;
    switch (message->what) {
    case kExpired:
        passing_.reset();
        update();
        break;
    case kDismissed:
        if (isSeen())
            removeFront();
        break;
    case kKeyPressed:
        message->FindInt32("button", &button);
        if (isSeen() && button < static_cast<int32>(front()->buttons.size()))
            buttons_[static_cast<std::size_t>(button)]->Invoke();
        break;
    default:
        BView::MessageReceived(message);
    }
}

void NoticeLine::show(Notice notice)
{
    // What is new is seen at once, or it takes its place in the queue.
    const std::optional<Notice> former = std::exchange(passing_, std::nullopt);
    if (notice.isPassing) {
        const auto now = std::chrono::steady_clock::now();
        if (former && former->isRemark && !notice.isRemark && now - passingSince_ < kTogether)
            notice.text += " (" + former->text + ")";
        passingSince_ = now;
        passing_ = std::move(notice);
        const BMessage expired(kExpired);
        expiry_ = std::make_unique<BMessageRunner>(BMessenger(this), &expired, kPassingTime);
    } else {
        const auto same = std::ranges::find(waiting_, notice.key, &Notice::key);
        if (notice.isAnswer) {
            if (same != waiting_.end())
                waiting_.erase(same);
            waiting_.push_front(std::move(notice));
        } else if (same != waiting_.end())
            *same = std::move(notice);
        else
            waiting_.insert(notice.isOffer ? waiting_.end() : std::ranges::find_if(waiting_, &Notice::isOffer),
                            std::move(notice));
    }
    update();
}

void NoticeLine::drop(const std::string& key)
{
    if (passing_ && passing_->key == key)
        passing_.reset();
    std::erase_if(waiting_, [&](const Notice& notice) { return notice.key == key; });
    update();
}

void NoticeLine::press(BMessage* message)
{
    int32 button = 0, shown = 0;
    if (message->FindInt32("button", &button) != B_OK || message->FindInt32("shown", &shown) != B_OK ||
        shown != shown_ || front() == nullptr)
        return;
    // The notice goes first: what the button does may show another one, also of the same key.
    const auto action = front()->buttons[static_cast<std::size_t>(button)].press;
    removeFront();
    if (action)
        action();
}

void NoticeLine::Draw(BRect)
{
    seen_ = shown_;
    SetHighColor(kEdge);
    StrokeRect(Bounds());
}

void NoticeLine::MouseDown(BPoint)
{
    removeFront();
}

const Notice* NoticeLine::front() const
{
    if (passing_)
        return &*passing_;
    return waiting_.empty() ? nullptr : &waiting_.front();
}

void NoticeLine::removeFront()
{
    if (passing_)
        passing_.reset();
    else if (!waiting_.empty())
        waiting_.pop_front();
    update();
}

void NoticeLine::update()
{
    ++shown_;
    if (!passing_)
        expiry_.reset();
    const Notice* notice = front();
    if (notice == nullptr) {
        Hide();
        text_->setText("");
        return;
    }
    text_->ResizeTo(placeButtons(*notice) - 2 * kInset, Bounds().Height());
    text_->setText(notice->text);
    Invalidate();
    Show();
}

float NoticeLine::placeButtons(const Notice& notice)
{
    constexpr float kPadding = 12; // on both sides of a label
    float right = Bounds().Width() - kEdgeWidth;
    for (std::size_t i = buttons_.size(); i-- > 0;) {
        BButton& button = *buttons_[i];
        if (i >= notice.buttons.size()) {
            button.Hide();
            continue;
        }
        const char* label = notice.buttons[i].label.c_str();
        const float width = std::ceil(StringWidth(label)) + 2 * kPadding;
        button.SetLabel(label);
        auto* message = new BMessage(kPressed);
        message->AddInt32("button", static_cast<int32>(i));
        message->AddInt32("shown", shown_);
        button.SetMessage(message);
        button.MoveTo(right - width, kEdgeWidth);
        button.ResizeTo(width, Bounds().Height() - 2 * kEdgeWidth);
        button.Show();
        right -= width + look::kGap;
    }
    return right;
}
