#pragma once

#include <functional>
#include <string>
#include <vector>

/// What the window says beside the status line: something that a person should know of and can do something about,
/// whenever it suits.
struct Notice {
    struct Button {
        std::string label;
        std::function<void()> press; ///< run as a command, with the window locked
    };

    std::string key;             ///< a new notice takes the place of one with the same key, shown or waiting
    std::string text;            ///< one line; longer text is in the tool tip
    std::vector<Button> buttons; ///< at most three; pressing one also takes the notice away
    bool isPassing = false;      ///< goes by itself after some seconds, and does not queue
    bool isRemark = false;       ///< a passing one that is told behind another one which comes within a second
    bool isAnswer = false;       ///< to what was just done: goes before those that wait
    bool isOffer = false;        ///< waits behind all others, also behind those that come later
};
