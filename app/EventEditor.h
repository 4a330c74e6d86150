#pragma once

class CompanyView;
class PLWindow;

/// The commands on the events of the company that is selected. Events change no quote and no value, so none of these
/// has the portfolio valued.
class EventEditor {
public:
    /// Both outlive this.
    EventEditor(PLWindow& window, CompanyView& page) : window_(window), page_(page) {}

    void add();
    void update();
    /// Destroys all selected events.
    void remove();
    /// Puts the selected event into the page's fields; without one they are as at the start.
    void showSelected();

private:
    PLWindow& window_;
    CompanyView& page_;
};
