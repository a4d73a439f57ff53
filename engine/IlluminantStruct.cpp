#include "IlluminantStruct.h"

#include "IlluminantSetup.h"

bool IlluminantStruct::operator==(const IlluminantStruct& other) const {
    if (observer != other.observer || observerAge != other.observerAge || fieldSize != other.fieldSize ||
        kind != other.kind || colorTemperature != other.colorTemperature || tableStart != other.tableStart ||
        tableEnd != other.tableEnd || tableStep != other.tableStep || valueCount != other.valueCount) {
        return false;
    }
    // A record without values still matches one with values: the values follow from the fields above.
    if (values.empty() || other.values.empty()) return true;
    return values == other.values;
}

void IlluminantStruct::SetIlluminant(IlluminantKind kind, double temperature) {
    ApplyIlluminant(*this, static_cast<int32_t>(kind), temperature);
}
