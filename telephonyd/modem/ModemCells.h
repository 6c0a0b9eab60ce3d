#pragma once

#include "platform/Value.h"
#include "telephonyd/modem/AccessTechnology.h"
#include "telephonyd/modem/ThreeGppLocation.h"

#include <QVariantMap>

namespace pelorus {

/// What the modem says about its serving cell without being asked for cells.
struct ServingCellFacts {
    CellKind kind = CellKind::none;
    ThreeGppLocation location;
    OperatorCode operatorCode;
    QVariantMap signal; // the dictionary of that technology
    QVariantList bands; // CurrentBands
};

/// The dictionary of the serving cell in a cell-monitor list; nil when the modem is in no cell that is known.
/// Of LTE the levels stand where UMTS has its own: RSRP under RSCP, RSRQ under Ec/N0.
Value servingCell(const ServingCellFacts& facts);

/// One cell of GetCellInfo(); nil for one that cannot be shown (of another technology, or without a type).
/// What is missing or out of range is left out, but for measurements of neighbours: those are marked as
/// unavailable.
Value cellOf(const QVariantMap& info);

/// The cell-monitor list. The serving cell of GetCellInfo() wins; what it leaves out is taken from the facts
/// when they are of the same cell.
Value cellMonitorList(const QVariantList& infos, const ServingCellFacts& facts);

} // namespace pelorus
