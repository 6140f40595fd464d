#pragma once

#include <vector>

#include <QPolygonF>

namespace ktr::linux_ {

/// Joins the pieces of one street, river or border: where the end of one is the beginning of another, and the way goes
/// on without a sharp turn. Longest first. Any thread.
std::vector<QPolygonF> joinLines(std::vector<QPolygonF> pieces);

/// Points.
double lengthOf(const QPolygonF& line);

}  // namespace ktr::linux_
