#pragma once

#include "platform/Value.h"
#include "telephonyd/modem/AccessTechnology.h"
#include "telephonyd/modem/ObjectTree.h"
#include "telephonyd/modem/ThreeGppLocation.h"

namespace pelorus {

/// One modem among ModemManager's objects: what it is on, and the three lists that are made of it. Looks at
/// the tree whenever it is asked.
class ModemView {
public:
    explicit ModemView(const ObjectTree& objects) : objects(objects) {}

    /// Empty for none.
    void look(const QString& modem) { path = modem; }
    bool isThere() const { return !path.isEmpty(); }

    QVariantMap properties() const; // of the interface Modem
    CellKind servingKind() const;
    /// The SIM and the bearers, with the interface of each.
    QMap<QString, QString> companions() const;

    Value simFiles() const; // nil while the SIM is not told of
    Value contexts() const;
    /// `infos` are what GetCellInfo() answered.
    Value cells(const QVariantList& infos, const ThreeGppLocation& location) const;

private:
    QString simPath() const;
    QStringList bearerPaths() const;

    const ObjectTree& objects;
    QString path;
};

} // namespace pelorus
