#pragma once

#include "platform/TextControl.h"

#include <functional>
#include <memory>

class QObject;

/// A field for what is searched. The kits have none.
///
/// Tells of each change by hand. Escape empties it and leaves it, Enter and Down leave it; a mark in it empties it by a
/// click.
class BSearchControl : public BTextControl {
public:
    BSearchControl(BRect frame, const char* name, const char* label, const char* hint);
    ~BSearchControl() override;

    /// `changed` is called after each change by hand, `left` when a key asks to leave the field.
    void SetHooks(std::function<void()> changed, std::function<void()> left);

    void TextModified() override;

private:
    class Keys;

    std::function<void()> changed_;
    std::function<void()> left_;
    std::unique_ptr<Keys> keys_; // watches the field's
};
