#ifndef REISTI_MIXTURE_EXTREME_VERTICES_DESIGN_H
#define REISTI_MIXTURE_EXTREME_VERTICES_DESIGN_H

#include <cstdint>
#include <vector>

#include "matrix/matrix_library.h"
#include "mixture/simplex_lattice_design.h"
#include "reisti/reisti.h"

namespace reisti {

/// Builds an extreme vertices design: the vertices of the region that bounds and linear constraints leave, the
/// centroids of its faces up to dimension degree-1, and on request the mean of the vertices and an axial point for each
/// vertex. What it takes from the lattice is its place in the order of the steps; the region need not be a simplex.
class ExtremeVerticesDesign : public SimplexLatticeDesign {
  public:
    /// @param constraints [numConstraints] the caller's, whose status is written
    /// @param maxPoints   most vertices and centroids
    ExtremeVerticesDesign(des_MixtureDesign* design, int degree, bool centerPoint, int numConstraints,
                          des_MixtureDesignLinearConstraint* constraints, int maxPoints);

    void CheckDegree(int& error) override;

  protected:
    /// Finds the points of the design. The bounds in the record move to where the region ends.
    void CalculateNumVerticesEdgesFaces(int& error) override;
    void GenerateBaseDesign() override;
    void GenerateOverallCenterpoint() override;
    void GenerateAxialPoints() override;
    void RescaleMixtureCatalogDesigns() override;

  private:
    bool HasFiniteBounds() const;
    void FindVertices(int& numPlanes);
    bool IsMeanOfVerticesAppended() const;
    std::vector<double> MeanOfVertices() const;
    void ConvertToPseudoComponents();

    unsigned int numVertices_;
    int numConstraints_;
    int numCentroids_ = 0;
    int maxPoints_;
    des_MixtureDesignLinearConstraint* constraints_;
    qan::matrix_library::matrix<double> slack_;   // [numVertices][planes], until the centroids have been found
    qan::matrix_library::matrix<double> points_;  // [numVertices + numCentroids][q]
};

}  // namespace reisti

#endif
