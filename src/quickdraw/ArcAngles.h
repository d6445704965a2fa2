// Toolbox arc angles to Qt's.
#pragma once

namespace Velmar::Private {

struct QtArc {
    int start; // sixteenths of a degree, counter-clockwise from 3 o'clock
    int span;
};

// start = (450 - startAngle - arcAngle) brought into 0..359, span = arcAngle; both x16.
constexpr QtArc toQtArc(int startAngle, int arcAngle)
{
    const int start = ((450 - startAngle - arcAngle) % 360 + 360) % 360;
    return QtArc{start * 16, arcAngle * 16};
}

} // namespace Velmar::Private
