// The steps that derived engines replace: their order, and what a step that fails stops.
#include <gmock/gmock.h>
#include <gtest/gtest.h>
#include <string>
#include <vector>

#include "mixture/simplex_centroid_design.h"
#include "mixture/simplex_lattice_design.h"
#include "reisti/reisti.h"
#include "unit/mixture/expect_plain.h"

namespace reisti::test {
namespace {

using testing::ElementsAre;
using testing::IsEmpty;

constexpr int kOwnCode = 4711;

/// Notes every replaceable step and runs the original; one of them can be told to fail.
template <typename Engine>
class Recording : public Engine {
  public:
    using Engine::Engine;

    std::vector<std::string> steps;
    std::string failing;

    void CheckBoundsInMixtures(int& error) override {
        note("bounds", &error);
        if (error == 0) Engine::CheckBoundsInMixtures(error);
    }
    void CalculateNumVerticesEdgesFaces(int& error) override {
        note("boundaries", &error);
        if (error == 0) Engine::CalculateNumVerticesEdgesFaces(error);
    }
    void GenerateBaseDesign() override {
        note("base", nullptr);
        Engine::GenerateBaseDesign();
    }
    void GenerateOverallCenterpoint() override {
        note("centre", nullptr);
        Engine::GenerateOverallCenterpoint();
    }
    void GenerateAxialPoints() override {
        note("axial", nullptr);
        Engine::GenerateAxialPoints();
    }
    void RescaleMixtureCatalogDesigns() override {
        note("rescale", nullptr);
        Engine::RescaleMixtureCatalogDesigns();
    }

  protected:
    void note(const std::string& step, int* error) {
        steps.push_back(step);
        if (step == failing) *error = kOwnCode;
    }
};

class RecordingLattice : public Recording<SimplexLatticeDesign> {
  public:
    using Recording<SimplexLatticeDesign>::Recording;

    void CheckDegree(int& error) override {
        note("degree", &error);
        if (error == 0) SimplexLatticeDesign::CheckDegree(error);
    }
};

TEST(EngineSteps, OfTheCentroidRunInThisOrder) {
    MixtureRecord record(centroidRequest(3));
    Recording<SimplexCentroidDesign> engine(record.get());
    int error = 0;
    engine.Calculate(error);
    EXPECT_EQ(error, des_Success);
    EXPECT_THAT(engine.steps, ElementsAre("bounds", "boundaries", "base", "centre", "axial", "rescale"));
}

TEST(EngineSteps, OfTheLatticeStartWithTheDegree) {
    MixtureRecord record(latticeRequest(3, 2));
    RecordingLattice engine(record.get(), 2, false);
    int error = 0;
    engine.Calculate(error);
    EXPECT_EQ(error, des_Success);
    EXPECT_THAT(engine.steps, ElementsAre("degree", "bounds", "boundaries", "base", "centre", "axial", "rescale"));
}

TEST(EngineSteps, ErrorOfAnEarlierCallIsCleared) {
    MixtureRecord record(centroidRequest(3));
    int error = kOwnCode;
    SimplexCentroidDesign(record.get()).Calculate(error);
    EXPECT_EQ(error, des_Success);
    EXPECT_EQ(record->numRuns, 7U);
}

TEST(EngineSteps, ErrorOfAnEarlierCallIsClearedForALattice) {
    MixtureRecord record(latticeRequest(3, 2));
    int error = kOwnCode;
    SimplexLatticeDesign(record.get(), 2, false).Calculate(error);
    EXPECT_EQ(error, des_Success);
    EXPECT_EQ(record->numRuns, 6U);
}

TEST(EngineSteps, FailedBoundsStopThePipeline) {
    MixtureRecord record(centroidRequest(3));
    Recording<SimplexCentroidDesign> engine(record.get());
    engine.failing = "bounds";
    int error = 0;
    engine.Calculate(error);
    EXPECT_EQ(error, kOwnCode);
    EXPECT_THAT(engine.steps, ElementsAre("bounds"));
}

TEST(EngineSteps, FailedBoundariesStopThePipelineBeforeRunsAreMade) {
    MixtureRecord record(centroidRequest(3));
    Recording<SimplexCentroidDesign> engine(record.get());
    engine.failing = "boundaries";
    int error = 0;
    engine.Calculate(error);
    EXPECT_EQ(error, kOwnCode);
    EXPECT_THAT(engine.steps, ElementsAre("bounds", "boundaries"));
    EXPECT_EQ(record->runs, nullptr);
}

TEST(EngineSteps, FailedDegreeStopsTheLatticeAtOnce) {
    MixtureRecord record(latticeRequest(3, 2));
    RecordingLattice engine(record.get(), 2, false);
    engine.failing = "degree";
    int error = 0;
    engine.Calculate(error);
    EXPECT_EQ(error, kOwnCode);
    EXPECT_THAT(engine.steps, ElementsAre("degree"));
}

TEST(EngineSteps, RefusedTotalsReachNoStep) {
    MixtureRequest request = centroidRequest(3);
    request.amounts = {1, 2};
    request.numProcessVariables = 1;
    MixtureRecord record(request);
    Recording<SimplexCentroidDesign> engine(record.get());
    int error = 0;
    engine.Calculate(error);
    EXPECT_EQ(error, des_ErrorAmountsAndProcess);
    EXPECT_THAT(engine.steps, IsEmpty());
}

TEST(EngineSteps, UncataloguedFractionStopsBeforeRescaling) {
    MixtureRequest request = centroidRequest(3);
    request.numProcessVariables = 9;
    request.processFraction = 2;
    MixtureRecord record(request);
    Recording<SimplexCentroidDesign> engine(record.get());
    int error = 0;
    engine.Calculate(error);
    EXPECT_EQ(error, des_ErrorProcessFraction);
    EXPECT_THAT(engine.steps, ElementsAre("bounds", "boundaries", "base", "centre", "axial"));
}

TEST(Engine, IsAnEngineOfItsBaseClass) {
    MixtureRecord record(latticeRequest(3, 2));
    SimplexLatticeDesign lattice(record.get(), 2, true);
    SimplexCentroidDesign& engine = lattice;
    int error = 0;
    engine.Calculate(error);
    EXPECT_EQ(error, des_Success);
    EXPECT_EQ(record->numRuns, 7U);
}

}  // namespace
}  // namespace reisti::test
