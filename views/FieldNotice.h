#pragma once

#include "platform/Message.h"
#include "platform/View.h"
#include "platform/Window.h"

#include <string>

/// The code by which a page asks its window for a notice about what was typed; the text is under "text".
constexpr uint32 kFieldNotice = 'NtFd';

/// Has the window of `field` say something about it, as soon as what waits before is done.
inline void tellAboutField(const BView& field, const std::string& text)
{
    if (field.Window() == nullptr)
        return;
    BMessage notice(kFieldNotice);
    notice.AddString("text", text.c_str());
    field.Window()->PostMessage(&notice);
}
