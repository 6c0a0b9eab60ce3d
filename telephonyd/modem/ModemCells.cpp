#include "telephonyd/modem/ModemCells.h"

#include "LogGenerator/Osprey/CellMonitorKeys.h"
#include "telephonyd/modem/LteBand.h"
#include "telephonyd/modem/PlainValue.h"

#include <cmath>

namespace pelorus {

namespace {

using namespace CellMonitor;

// Values of "cell-type".
constexpr std::uint32_t kTypeGsm = 2;
constexpr std::uint32_t kTypeUmts = 3;
constexpr std::uint32_t kTypeLte = 5;

constexpr std::uint32_t kMostArfcn = 1023;
constexpr std::uint32_t kMostUarfcn = 16383;
constexpr std::uint32_t kMostEarfcn = 262143;
constexpr std::uint32_t kMostScramblingCode = 511;
constexpr std::uint32_t kMostPhysicalIdentity = 503;
constexpr std::uint32_t kMostReceiveLevel = 63;
constexpr double kLevelOfReceiveLevel0 = -110; // dBm (3GPP TS 45.008, 8.1.4)

constexpr std::size_t kMostCells = 128; // far more than any modem measures

std::string_view technologyName(CellKind kind)
{
    return kind == CellKind::lte ? kLTE : kind == CellKind::umts ? kUMTS : kGSM;
}

std::shared_ptr<Dictionary> newCell(CellKind kind, bool serving)
{
    auto cell = makeDictionary();
    cell->set(kRadioAccessTechnology, technologyName(kind));
    cell->set(kCellType, serving ? kServing : kNeighbor);
    return cell;
}

template <class Number> void put(Dictionary& cell, std::string_view key, std::optional<Number> number)
{
    if (number)
        cell.set(key, std::int64_t{*number});
}

/// A level as decibels; what cannot be one is none.
std::optional<double> level(const QVariantMap& from, const char* key)
{
    const auto decibels = realAt(from, key);
    return decibels && std::abs(*decibels) < 200 ? decibels : std::nullopt;
}

void putLevel(Dictionary& cell, std::string_view key, std::optional<double> decibels, double unit = 1)
{
    if (decibels)
        cell.set(key, static_cast<std::int64_t>(std::lround(*decibels / unit)));
}

void putHalfLevel(Dictionary& cell, std::string_view key, std::optional<double> decibels)
{
    putLevel(cell, key, decibels, 2);
}

void putOperator(Dictionary& cell, const OperatorCode& code)
{
    put(cell, kMCC, code.countryCode);
    put(cell, kMNC, code.networkCode);
}

void markMissing(Dictionary& cell, std::initializer_list<std::string_view> measurements)
{
    for (const std::string_view key : measurements)
        if (!cell.find(key))
            cell.set(key, int{kUnavailable});
}

std::optional<std::uint32_t> hexAt(const QVariantMap& info, const char* key, std::uint32_t most)
{
    return hexNumber(textAt(info, key), most);
}

std::optional<std::uint32_t> numberAt(const QVariantMap& info, const char* key, std::uint32_t most)
{
    const auto number = unsignedAt(info, key);
    return number && *number <= most ? number : std::nullopt;
}

Value gsmCell(const QVariantMap& info, bool serving)
{
    auto cell = newCell(CellKind::gsm, serving);
    putOperator(*cell, OperatorCode::parse(textAt(info, "operator-id")));
    put(*cell, kLAC, hexAt(info, "lac", kMostAreaCode));
    put(*cell, kCellId, hexAt(info, "ci", 0xFFFF));
    put(*cell, kARFCN, numberAt(info, "arfcn", kMostArfcn));
    if (const auto receiveLevel = numberAt(info, "rx-level", kMostReceiveLevel))
        putHalfLevel(*cell, kRSSI, kLevelOfReceiveLevel0 + *receiveLevel);
    if (!serving)
        markMissing(*cell, {kRSSI});
    return cell;
}

Value umtsCell(const QVariantMap& info, bool serving)
{
    auto cell = newCell(CellKind::umts, serving);
    putOperator(*cell, OperatorCode::parse(textAt(info, "operator-id")));
    put(*cell, kLAC, hexAt(info, "lac", kMostAreaCode));
    put(*cell, kCellId, hexAt(info, "ci", kMostCellIdentity));
    put(*cell, kUARFCN, numberAt(info, "uarfcn", kMostUarfcn));
    put(*cell, kSCN, numberAt(info, "psc", kMostScramblingCode));
    putLevel(*cell, kRSCP, level(info, "rscp"));
    putLevel(*cell, kECN0, level(info, "ecio"));
    if (!serving)
        markMissing(*cell, {kRSCP, kECN0});
    return cell;
}

Value lteCell(const QVariantMap& info, bool serving)
{
    auto cell = newCell(CellKind::lte, serving);
    putOperator(*cell, OperatorCode::parse(textAt(info, "operator-id")));
    put(*cell, kTAC, hexAt(info, "tac", kMostAreaCode));
    put(*cell, kCellId, hexAt(info, "ci", kMostCellIdentity));
    put(*cell, kPID, hexAt(info, "physical-ci", kMostPhysicalIdentity));
    if (const auto earfcn = numberAt(info, "earfcn", kMostEarfcn)) {
        put(*cell, kBandInfo, lteBand(*earfcn));
        put(*cell, kUARFCN, earfcn);
    }
    putLevel(*cell, kRSCP, level(info, "rsrp"));
    putLevel(*cell, kECN0, level(info, "rsrq"));
    if (!serving)
        markMissing(*cell, {kRSCP, kECN0});
    return cell;
}

/// The LTE band of a modem that is set to a single one.
std::optional<int> onlyLteBand(const QVariantList& bands)
{
    std::optional<int> only;
    for (const QVariant& value : bands) {
        const auto band = lteBandOfModem(value.toUInt());
        if (band && only)
            return std::nullopt;
        if (band)
            only = band;
    }
    return only;
}

bool contradict(const Dictionary& one, const Dictionary& other, std::string_view key)
{
    const Value* here = one.find(key);
    const Value* there = other.find(key);
    return here && there && *here != *there;
}

/// The facts are asked for at another time than the cells, and may be of another cell.
bool canBeSameCell(const Dictionary& one, const Dictionary& other)
{
    for (const std::string_view key : {kRadioAccessTechnology, kMCC, kMNC, kLAC, kTAC, kCellId})
        if (contradict(one, other, key))
            return false;
    return true;
}

bool isServing(const Dictionary& cell)
{
    return cell.at(kCellType) == Value(kServing);
}

} // namespace

Value servingCell(const ServingCellFacts& facts)
{
    const ThreeGppLocation& where = facts.location;
    OperatorCode code = facts.operatorCode;
    if (where.countryCode && where.networkCode)
        code = {where.countryCode, where.networkCode};
    if (facts.kind == CellKind::none || (!code.countryCode && !where.cellIdentity))
        return {};
    auto cell = newCell(facts.kind, true);
    putOperator(*cell, code);
    if (facts.kind == CellKind::lte) {
        // Modems that were asked by the commands of older networks tell the tracking area as location area.
        put(*cell, kTAC, where.trackingArea ? where.trackingArea : where.locationArea);
        put(*cell, kCellId, where.cellIdentity);
        put(*cell, kBandInfo, onlyLteBand(facts.bands));
        putLevel(*cell, kRSCP, level(facts.signal, "rsrp"));
        putLevel(*cell, kECN0, level(facts.signal, "rsrq"));
    } else {
        put(*cell, kLAC, where.locationArea);
        put(*cell, kCellId, where.cellIdentity);
        putLevel(*cell, kRSCP, level(facts.signal, "rscp"));
        putLevel(*cell, kECN0, level(facts.signal, "ecio"));
    }
    putHalfLevel(*cell, kRSSI, level(facts.signal, "rssi"));
    return cell;
}

Value cellOf(const QVariantMap& info)
{
    const bool serving = flagAt(info, "serving");
    switch (unsignedAt(info, "cell-type").value_or(0)) {
    case kTypeGsm:
        return gsmCell(info, serving);
    case kTypeUmts:
        return umtsCell(info, serving);
    case kTypeLte:
        return lteCell(info, serving);
    default:
        return {};
    }
}

Value cellMonitorList(const QVariantList& infos, const ServingCellFacts& facts)
{
    auto list = makeArray();
    const Value known = servingCell(facts);
    bool hasServing = false;
    for (const QVariant& info : infos) {
        if (list->elements.size() == kMostCells)
            break;
        const Value cell = cellOf(info.toMap());
        if (!cell)
            continue;
        Dictionary& entries = *cell.dictionary();
        if (isServing(entries) && known && canBeSameCell(entries, *known.dictionary()))
            for (const auto& [key, value] : *known.dictionary())
                if (!entries.find(key.text()))
                    entries.set(key.text(), value);
        hasServing = hasServing || isServing(entries);
        // The first of its kind is what is shown, so the serving cell stands before the others.
        list->elements.insert(isServing(entries) ? list->elements.begin() : list->elements.end(), cell);
    }
    if (!hasServing && known)
        list->elements.insert(list->elements.begin(), known);
    return list;
}

} // namespace pelorus
