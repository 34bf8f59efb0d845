// What the tests of the kernels share: one run for each level that the machine has.
#ifndef REISTI_TESTS_PROPERTY_MATRIX_KERNEL_LEVELS_H
#define REISTI_TESTS_PROPERTY_MATRIX_KERNEL_LEVELS_H

#include <gtest/gtest.h>
#include <string>

#include "matrix/kernels/level_table.h"
#include "support/plain_linear_algebra.h"
#include "support/random_values.h"

namespace reisti::test {

class KernelLevels : public testing::TestWithParam<kernels::Level> {
  protected:
    void SetUp() override {
        if (!kernels::isAvailable(GetParam())) GTEST_SKIP() << "this processor lacks " << kernels::name(GetParam());
    }
    static const kernels::LevelTable& table() { return kernels::tableOf(GetParam()); }
};

inline std::string levelName(const testing::TestParamInfo<kernels::Level>& instance) {
    return kernels::name(instance.param);
}

using Draw = double (RandomValues::*)();

inline PlainMatrix randomMatrix(RandomValues& random, std::size_t rows, std::size_t cols, Draw draw) {
    PlainMatrix a(rows, cols);
    for (double& value : a.values)
        value = (random.*draw)();
    return a;
}

}  // namespace reisti::test

#endif
