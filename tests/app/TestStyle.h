#pragma once

#include <QProxyStyle>

namespace pelorus::test {

/// A desktop that wants no motion, until a test says otherwise.
class TestStyle : public QProxyStyle {
public:
    TestStyle() : QProxyStyle("Fusion") {}
    int styleHint(StyleHint hint, const QStyleOption* option, const QWidget* widget,
                  QStyleHintReturn* data) const override
    {
        return hint == SH_Widget_Animation_Duration ? duration
                                                    : QProxyStyle::styleHint(hint, option, widget, data);
    }

    static inline int duration = 0;
};

} // namespace pelorus::test
