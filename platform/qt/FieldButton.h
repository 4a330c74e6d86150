#pragma once

#include <QIcon>
#include <QWidget>
#include <functional>

/// A button inside of a field, at its right end, for the mouse. It is no stop for the Tab key: what it does has a key
/// in the field.
class FieldButton final : public QWidget {
public:
    /// A child of `field`, which places it.
    FieldButton(QWidget& field, const QIcon& icon, std::function<void()> press);

    void press() const { press_(); }

protected:
    void paintEvent(QPaintEvent* event) override;
    void mousePressEvent(QMouseEvent* event) override;

private:
    QIcon icon_;
    std::function<void()> press_;
};
