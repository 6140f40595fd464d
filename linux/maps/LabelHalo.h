#pragma once

#include <QList>
#include <QPolygonF>

namespace ktr::linux_ {

/// What lies within a distance of a letter. Stateless; any thread.
class LabelHalo {
  public:
    /// Rings to be filled with Qt::WindingFill. `rings` are a letter's, the ink always on the same side of them as
    /// fonts have it; `distance` is in their unit. They cross each other and themselves, where the ink counts more than
    /// once: that is a fraction of the edges that a stroke of the letter has, and each picture goes through them all.
    static QList<QPolygonF> around(const QList<QPolygonF>& rings, double distance);
};

}  // namespace ktr::linux_
