#pragma once

#include <functional>
#include <string>
#include <utility>

/// A field, of the class `Control`, that suggestions can be put into. They never replace what a person typed, or what
/// was shown there for another reason.
template <class Control>
class OfferField final : public Control {
public:
    using Control::Control;

    /// What is called after each change by hand.
    void setTypingHook(std::function<void()> hook) { hook_ = std::move(hook); }

    /// Whether a suggestion may be put in: the field is empty, or holds nothing but an earlier suggestion.
    bool isOpen() const { return isOffer_ || *Control::Text() == '\0'; }
    /// Whether it holds a suggestion.
    bool isOffer() const { return isOffer_; }
    /// What the field holds was just put in as a suggestion.
    void noteOffer() { isOffer_ = true; }
    /// What the field holds was not.
    void noteShown() { isOffer_ = false; }
    /// Empties the field when it holds a suggestion.
    void withdrawOffer()
    {
        if (std::exchange(isOffer_, false))
            Control::SetText("");
    }

    void TextModified() override
    {
        isOffer_ = false;
        Control::TextModified();
        if (hook_)
            hook_();
    }

private:
    std::function<void()> hook_;
    bool isOffer_ = false;
};
