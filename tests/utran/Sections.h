#pragma once

namespace pelorus::test {

/// The sections of the UTRAN2 template, by what holds their rows.
inline constexpr const char* kKeyedSections[] = {"RRC Info", "Serving Cell Info", "SIM Info"};
inline constexpr const char* kListSections[] = {"Neighbor Cell List", "GSM Neighbor Cell List", "TRCH BLER",
                                                "CCTRCH SIR", "PDP Context Info"};

} // namespace pelorus::test
