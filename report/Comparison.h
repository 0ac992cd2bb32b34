#pragma once

#include "report/Facts.h"

namespace report {

/// How far two tables are apart as people see them: at the points of the larger one and at 10,000
/// random colours, half of them of each table's domain.
Orlith::LUT::Differences compareLooks(const Orlith::LUT::LUT& a, const Look& lookA,
                                      const Orlith::LUT::LUT& b, const Look& lookB);

}  // namespace report
