#ifndef REISTI_MIXTURE_EXTREME_VERTEX_UTIL_H
#define REISTI_MIXTURE_EXTREME_VERTEX_UTIL_H

#include <cstdint>

#include "matrix/matrix_library.h"
#include "reisti/reisti.h"

namespace reisti {

/// Finds the vertices of a mixture region {x : sum of x = 1, lower <= x <= upper, linear constraints}, the planes that
/// bound it and the values of the planes at the vertices.
///
/// A plane is a row of q coefficients and a constant; its function is not negative within the region. Planes are
/// numbered: 0 .. q-1 the lower bounds (x - lower), q .. 2q-1 the upper bounds (upper - x), then the planes of the
/// constraints that cut the region, in the order of the constraints, lower before upper side.
class CmExtremeVertexUtil {
  public:
    CmExtremeVertexUtil() = default;
    CmExtremeVertexUtil(const CmExtremeVertexUtil&) = delete;
    CmExtremeVertexUtil& operator=(const CmExtremeVertexUtil&) = delete;
    virtual ~CmExtremeVertexUtil() = default;

    /// The whole task. With constraints, bounds that the region does not reach are moved to where it ends, and
    /// *boundsChanged is set then; it is never cleared.
    /// @param total  what the sides of the constraints are divided by
    /// @param points [numVertices][q] the vertices
    /// @param slack  [numVertices][numPlanes] the values of the planes
    /// @return true
    /// @throw std::length_error or qan::matrix_library::MatrixException when a table cannot be indexed in 32 bits
    bool mExtremeVertex(int q, int numConstraints, double total, double* lowerBounds, double* upperBounds,
                        des_MixtureDesignLinearConstraint* constraints, std::uint8_t* boundsChanged,
                        unsigned int* numVertices, int* numPlanes, qan::matrix_library::matrix<double>& points,
                        qan::matrix_library::matrix<double>& slack);

    /// The vertices within the bounds alone, in the order of enumerateBoxVertices().
    void mGenerateVertices(int q, double* lowerBounds, double* upperBounds, unsigned int* numVertices,
                           qan::matrix_library::matrix<double>& points);

    /// The planes of the bounds, with rows of zeros for those to come, and their values at the vertices.
    void mInitCoeff(int q, int numConstraints, unsigned int* numVertices, double* lowerBounds, double* upperBounds,
                    qan::matrix_library::matrix<double>& points, int* numPlanes,
                    qan::matrix_library::matrix<double>& planes, qan::matrix_library::matrix<double>& slack);

    /// Cuts the region with one constraint after the other. A plane that does not cut is told in the status of its
    /// constraint and leaves no trace elsewhere.
    void mAddConstraints(int q, int numConstraints, unsigned int* numVertices, int* numPlanes, double total,
                         des_MixtureDesignLinearConstraint* constraints, qan::matrix_library::matrix<double>& points,
                         qan::matrix_library::matrix<double>& planes, qan::matrix_library::matrix<double>& slack);

    /// Where the last plane cuts the edge between vertices a and b, a on its negative side: appends this point unless
    /// the two share no edge or the point is near a vertex that the plane keeps. What mAddConstraints() does for all
    /// pairs at once, for a single one.
    void mEdge(int a, int b, int q, unsigned int* numVertices, int numPlanes,
               qan::matrix_library::matrix<double>& points, qan::matrix_library::matrix<double>& planes,
               qan::matrix_library::matrix<double>& slack);
};

}  // namespace reisti

#endif
