#include "telephonyd/modem/ModemView.h"

#include "telephonyd/modem/BearerRows.h"
#include "telephonyd/modem/ModemCells.h"
#include "telephonyd/modem/ModemNames.h"
#include "telephonyd/modem/ModemSimFiles.h"
#include "telephonyd/modem/PlainValue.h"

namespace pelorus {

namespace {

using namespace ModemNames;

bool isPath(const QString& path)
{
    return path.size() > 1; // "/" stands for none
}

const char* signalKey(CellKind kind)
{
    return kind == CellKind::lte ? "Lte" : kind == CellKind::umts ? "Umts" : "Gsm";
}

} // namespace

QVariantMap ModemView::properties() const
{
    return objects.properties(path, kModem);
}

CellKind ModemView::servingKind() const
{
    return pelorus::servingKind(unsignedAt(properties(), "AccessTechnologies").value_or(0));
}

QString ModemView::simPath() const
{
    return properties().value(QStringLiteral("Sim")).toString();
}

QStringList ModemView::bearerPaths() const
{
    QStringList paths;
    for (const QVariant& bearer : listAt(properties(), "Bearers"))
        paths.append(bearer.toString());
    // The one that an LTE modem gets with its registration is not among those.
    const QString initial =
        objects.properties(path, kModem3gpp).value(QStringLiteral("InitialEpsBearer")).toString();
    if (!paths.contains(initial))
        paths.prepend(initial);
    paths.removeIf([](const QString& bearer) { return !isPath(bearer); });
    return paths;
}

QMap<QString, QString> ModemView::companions() const
{
    QMap<QString, QString> interfaces;
    if (isPath(simPath()))
        interfaces.insert(simPath(), kSim);
    for (const QString& bearer : bearerPaths())
        interfaces.insert(bearer, kBearer);
    return interfaces;
}

Value ModemView::simFiles() const
{
    const QString sim = simPath();
    if (isPath(sim) && !objects.has(sim, kSim))
        return {};
    return simFilesOf(objects.properties(sim, kSim), properties());
}

Value ModemView::contexts() const
{
    auto contexts = makeArray();
    for (const QString& bearer : bearerPaths())
        if (objects.has(bearer, kBearer)) // told of already
            contexts->elements.push_back(bearerRows(bearer, objects.properties(bearer, kBearer)));
    return contexts;
}

Value ModemView::cells(const QVariantList& infos, const ThreeGppLocation& location) const
{
    ServingCellFacts facts;
    facts.kind = servingKind();
    facts.location = location;
    facts.operatorCode = OperatorCode::parse(textAt(objects.properties(path, kModem3gpp), "OperatorCode"));
    facts.signal = mapAt(objects.properties(path, kSignal), signalKey(facts.kind));
    facts.bands = listAt(properties(), "CurrentBands");
    return cellMonitorList(infos, facts);
}

} // namespace pelorus
