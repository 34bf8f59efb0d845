#include "dsd/conference_matrices.h"

namespace reisti {

namespace {

struct OrderedTable {
    std::uint32_t order;
    const std::int32_t* values;
};

constexpr std::array TABLES = {
    OrderedTable{4, DSD_4.data()},   OrderedTable{6, DSD_6.data()},   OrderedTable{8, DSD_8.data()},
    OrderedTable{10, DSD_10.data()}, OrderedTable{12, DSD_12.data()}, OrderedTable{14, DSD_14.data()},
    OrderedTable{16, DSD_16.data()}, OrderedTable{18, DSD_18.data()}, OrderedTable{20, DSD_20.data()},
    OrderedTable{24, DSD_24.data()}, OrderedTable{26, DSD_26.data()}, OrderedTable{30, DSD_30.data()},
    OrderedTable{32, DSD_32.data()}, OrderedTable{38, DSD_38.data()}, OrderedTable{42, DSD_42.data()},
    OrderedTable{44, DSD_44.data()}, OrderedTable{48, DSD_48.data()},
};

}  // namespace

const std::int32_t* conferenceMatrix(std::uint32_t order) {
    for (const OrderedTable& table : TABLES) {
        if (table.order == order) return table.values;
    }
    return nullptr;
}

std::uint32_t baseOrder(std::uint32_t numFactors) {
    for (const std::uint32_t order : DSD_SIZES) {
        if (numFactors <= order) return order;
    }
    return DSD_SIZES.back();
}

std::uint32_t baseRunCount(std::uint32_t numFactors, bool hasCategorical) {
    return 2 * baseOrder(numFactors) + (hasCategorical ? 2 : 1);
}

}  // namespace reisti
