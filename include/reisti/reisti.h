/**
 * @file reisti.h
 * @brief Experimental designs: definitive screening designs and mixture designs.
 *
 * The library constructs designs and hands them back in plain records. It reads no files, prints nothing and keeps no
 * state between calls.
 *
 * Call order, screening designs: ask des_FindDefinitiveScreeningDesignRowCount() how many runs a request gives,
 * allocate the runs and each run's levels, fill a des_DefinitiveScreeningDesign, call
 * des_CreateDefinitiveScreeningDesign(). Every array belongs to the caller; the library keeps none of them.
 *
 * Call order, mixture designs: des_CreateMixtureDesignContainer(), fill the inputs and point the record at the caller's
 * arrays, call one of the three run functions, read `runs`, des_DeleteMixtureDesignContainer(). The library owns the
 * record and `runs`; the caller owns every other array and frees it itself.
 *
 * Errors: functions return an error code, 0 for success (the row count writes it through a pointer). No exception
 * leaves the library. des_ErrorMessage() gives a sentence for every code. Each function tells, error by error, what it
 * leaves written.
 *
 * Threads: calls on different records may run at the same time; one record must not be used by two calls at once.
 *
 * Flags: byte flags are uint8_t; 0 is false and every other value is true. The library itself writes 0 and 1 only.
 *
 * Stability: within one SONAME no record changes its layout and no function its signature. New functions may be added.
 * Error codes are never renumbered.
 *
 * A complete program:
 * @code{.c}
 * #include <reisti/reisti.h>
 * #include <stdio.h>
 *
 * int main(void) {
 *     int32_t levels[13][4];
 *     des_DefinitiveScreeningRun runs[13];
 *     des_DefinitiveScreeningDesign design = {.numFactors = 4, .replicates = 1, .numBlocks = 1, .runs = runs};
 *     for (int i = 0; i < 13; ++i) runs[i].levels = levels[i];
 *     const int32_t code = des_CreateDefinitiveScreeningDesign(&design);
 *     if (code != des_Success) return fprintf(stderr, "%s\n", des_ErrorMessage(code)), 1;
 *     for (int i = 0; i < 13; ++i)
 *         printf("%2d %2d %2d %2d\n", levels[i][0], levels[i][1], levels[i][2], levels[i][3]);
 *     return 0;
 * }
 * @endcode
 */
#ifndef REISTI_REISTI_H
#define REISTI_REISTI_H

#include <stdint.h>

/** @def REISTI_API
 * Marks what the shared library exports; a host need not use it. */
#if defined(__GNUC__)
#define REISTI_API __attribute__((visibility("default")))
#else
#define REISTI_API
#endif

#ifdef __cplusplus
extern "C" {
#endif

/** Error codes, as returned by every function of this library. */
typedef enum des_ErrorCode {
    /** No error. */
    des_Success = 0,
    /** A screening design has 2 to 48 factors. */
    des_ErrorNumFactors = 30001,
    /** The runs of the replicated screening design cannot be counted in 32 bits. */
    des_ErrorTooManyReplicates = 30002,
    /** More categorical factors than factors. */
    des_ErrorTooManyCategorical = 30003,
    /** The index of a categorical factor is not below the number of factors. */
    des_ErrorCategoricalIndex = 30004,
    /** The blocks do not divide the replicates into equal whole numbers. */
    des_ErrorBlocks = 30005,
    /** The array of runs is null. */
    des_ErrorNullRuns = 30006,
    /** The levels of the first run are null. */
    des_ErrorNullLevels = 30007,
    /** The lower bounds of the components leave nothing free: they sum to the total or more. */
    des_ErrorLowerBoundSum = 30008,
    /** The upper bounds of the components cannot reach the total: they sum to the total or less. */
    des_ErrorUpperBoundSum = 30009,
    /** An upper bound is above the total. */
    des_ErrorUpperBound = 30010,
    /** A component has no room between its bounds. */
    des_ErrorEmptyRange = 30011,
    /** The bounded region is not a simplex, as this design requires. */
    des_ErrorNotSimplex = 30012,
    /** The process fraction does not fit the number of process variables, or no such fraction is known. */
    des_ErrorProcessFraction = 30013,
    /** Several mixture amounts cannot be combined with process variables. */
    des_ErrorAmountsAndProcess = 30014,
    /** The degree is not allowed for this number of components. */
    des_ErrorDegree = 30015,
    /** The region has more design points than the caller's limit. */
    des_ErrorTooManyPoints = 30016,
    /** Out of memory, or a count that does not fit the 32-bit counts of the records. */
    des_ErrorOutOfMemory = 30017,
    /** A required pointer is null. */
    des_ErrorNullPointer = 30018,
    /** A value that has to be a finite number is not. */
    des_ErrorNotANumber = 30019
} des_ErrorCode;

/**
 * @brief A constant English sentence for an error code.
 * @param code any value; unknown codes give a sentence that says so
 * @return static storage, never null, valid until the library is unloaded
 * @since 0.1
 */
REISTI_API const char* des_ErrorMessage(int32_t code);

/**
 * @brief The version of the library that is running, as "major.minor.patch".
 * @return static storage, never null
 * @since 0.1
 */
REISTI_API const char* des_Version(void);

/* ---------------------------------------------------------------------------------------------------------------- */
/* Definitive screening designs                                                                                     */
/* ---------------------------------------------------------------------------------------------------------------- */

/** Point types of a screening run. */
enum {
    /** A centre run. */
    des_ScreeningPointCenter = 0,
    /** A run none of whose levels is 0. */
    des_ScreeningPointNoZero = 1,
    /** A run with one level 0. */
    des_ScreeningPointOneZero = 2
};

/** @brief One run of a screening design.
 *
 * Record and levels belong to the caller. */
typedef struct des_DefinitiveScreeningRun {
    /** Out. 1-based position in which to run it: the index in `runs` plus 1 unless the design is randomized. */
    uint32_t runOrder;
    /** Out. 1-based block number. */
    uint32_t block;
    /** Out. One of the des_ScreeningPoint... constants. */
    uint32_t pointType;
    /** Out, [numFactors]. The caller's array, filled with the coded levels -1, 0 or +1. Null is detected in the first
     * run only. */
    int32_t* levels;
} des_DefinitiveScreeningRun;

/** @brief A screening design: request and result.
 *
 * Everything belongs to the caller; no input field is changed. */
typedef struct des_DefinitiveScreeningDesign {
    /** In. Number of factors n, 2..48. */
    uint32_t numFactors;
    /** In. Number of two-level categorical factors, 0..n. */
    uint32_t numCategorical;
    /** In. Number of copies of the whole base design; 0 counts as 1. */
    uint32_t replicates;
    /** In. Number of blocks, each made of whole replicates; read only when there are 2 replicates or more, of which it
     * has to be a divisor (0 puts every run in block 1). */
    uint32_t numBlocks;
    /** In, flag. Nonzero randomizes the order of the blocks and of the runs within each block. */
    uint8_t randomize;
    /** In. Seed of the randomization. 0 takes a fresh seed each time; any other value, NaN included, gives the same
     * order each time. */
    double seed;
    /** In, [numCategorical]. 0-based indices of the categorical factors, each below n; their order influences which
     * signs replace the zeros. May be null when numCategorical is 0. Never changed. */
    const uint32_t* categoricalFactors;
    /** Out, [des_FindDefinitiveScreeningDesignRowCount()]. The caller's array of runs in standard order: runs 2i and
     * 2i+1 are row i of the conference matrix and its negation, then the centre run, then (with categorical factors
     * only) its negation, then the further replicates. Randomizing changes `runOrder` alone. */
    des_DefinitiveScreeningRun* runs;
} des_DefinitiveScreeningDesign;

/**
 * @brief Number of runs of a screening design, for the caller to allocate.
 *
 * The base design has 2s+1 runs, and one more with categorical factors, s being the order of the smallest available
 * conference matrix with at least numFactors columns (6, 8, 10, 12, 14, 16, 18, 20, 24, 26, 30, 32, 38, 42, 44 or 48).
 *
 * @param numFactors     number of factors, 2..48
 * @param[out] error     receives des_Success, des_ErrorNumFactors or des_ErrorTooManyReplicates; may be null
 * @param hasCategorical flag: nonzero exactly when numCategorical will be nonzero
 * @param replicates     number of copies of the base design; 0 counts as 1
 * @return the number of runs, 0 on an error
 * @since 0.1
 */
REISTI_API uint32_t des_FindDefinitiveScreeningDesignRowCount(int32_t numFactors, int32_t* error,
                                                              uint8_t hasCategorical, uint32_t replicates);

/**
 * @brief Fills the caller's runs with a definitive screening design.
 *
 * Foldover pairs of the rows of a conference matrix, one centre run (two when some factors are categorical), the zero
 * level of each categorical factor replaced by a sign, whole replicates, blocks of whole replicates, and a random run
 * order on request. Allocates nothing that outlives the call. Source: B. Jones and C. J. Nachtsheim, "A class of
 * three-level designs for definitive screening in the presence of second-order effects", J. Quality Technology 43
 * (2011) 1-15; categorical factors: the same authors, J. Quality Technology 45 (2013) 121-129.
 *
 * The tests are made in this order; the first that fails decides.
 *
 * @param design the request; its `runs` hold at least as many records as the row count, each with levels[numFactors]
 * @retval des_ErrorNullPointer        design is null; nothing written. Or, tested after des_ErrorTooManyCategorical,
 *                                     numCategorical is nonzero and `categoricalFactors` null; the even base runs are
 *                                     written
 * @retval des_ErrorNullRuns           `runs` is null; nothing written
 * @retval des_ErrorNumFactors         fewer than 2 or more than 48 factors; nothing written
 * @retval des_ErrorNullLevels         `levels` of the first run is null; nothing written
 * @retval des_ErrorTooManyCategorical more categorical factors than factors; the even base runs 0, 2, .., 2s-2 are
 *                                     written
 * @retval des_ErrorCategoricalIndex   an index is not below numFactors; the even base runs are written
 * @retval des_ErrorTooManyReplicates  the runs cannot be counted in 32 bits; the base runs are complete
 * @retval des_ErrorBlocks             2 replicates or more, not a multiple of numBlocks; the base runs are complete
 * @retval des_ErrorOutOfMemory        no memory for the randomization (the whole design is written, in standard order)
 *                                     or for the choice of signs (the even base runs are written)
 * @retval des_Success                 the design is complete
 * @since 0.1
 */
REISTI_API int32_t des_CreateDefinitiveScreeningDesign(des_DefinitiveScreeningDesign* design);

/* ---------------------------------------------------------------------------------------------------------------- */
/* Mixture designs                                                                                                  */
/* ---------------------------------------------------------------------------------------------------------------- */

/** Values of des_MixtureDesign::outputUnits: what the proportions of the runs hold. */
enum {
    /** Component amounts: proportions times the total, where totals are given. */
    des_UnitsAmount = 0,
    /** Actual proportions. */
    des_UnitsProportion = 1,
    /** Proportions of the L-pseudo-components; not finite where bounds and constraints leave a single mixture. */
    des_UnitsPseudo = 2
};

/** Point types of a mixture run other than the positive ones. */
enum {
    /** An axial point. */
    des_MixturePointAxial = -1,
    /** The overall centroid. */
    des_MixturePointCentroid = 0,
    /** A vertex. */
    des_MixturePointVertex = 1
};

/** @brief One run of a mixture design.
 *
 * Record and arrays belong to the library. */
typedef struct des_MixtureRun {
    /** Out. 1-based position in which to run it: the index in `runs` plus 1 unless the design is randomized. */
    uint32_t runOrder;
    /** Always 1; has no meaning to the caller. */
    uint32_t reserved;
    /** Out. k >= 1: centroid and lattice designs, a point with k nonzero proportions; extreme vertices designs, 1 a
     * vertex and k the centroid of a face of dimension k-1. 0: the overall centroid. -1: an axial point. */
    int32_t pointType;
    /** Out, [numComponents]. Component proportions, in the units that `outputUnits` asked for. */
    double* proportions;
    /** Out. Total amount of the run; 1 when no amounts were given. */
    double amount;
    /** Out, [numProcessVariables]. Level -1 or +1 of each process variable; null when there are none. */
    int32_t* processLevels;
} des_MixtureRun;

/** @brief A mixture design: request and result.
 *
 * q is `numComponents`. The library allocates and frees the record and `runs`; all other arrays are the caller's and
 * have to be there before a run, also those that a run only writes. */
typedef struct des_MixtureDesign {
    /** In, 3 after creation. Number of components q. */
    uint32_t numComponents;
    /** In, [q], required. Lower bound of each component, in the units of the total; 0 for an unbounded component. A run
     * divides the bounds by the total, may tighten them, and multiplies them back at its end. A failed run leaves them
     * divided: a caller that tries again has to set them again. */
    double* lowerBounds;
    /** In, [q], required. Upper bound of each component, likewise; the total for an unbounded component. */
    double* upperBounds;
    /** Out, [q], required. Lower bounds divided by the total. */
    double* scaledLowerBounds;
    /** Out, [q], required. Upper bounds divided by the total. */
    double* scaledUpperBounds;
    /** Out, [q], required. Lower bounds of the L-pseudo-components: always 0. */
    double* pseudoLowerBounds;
    /** Out, [q], required. Upper bounds of the L-pseudo-components; not finite where a single mixture is left. */
    double* pseudoUpperBounds;
    /** Out, [q], required. Entry t-1: number of distinct base points of type t. */
    uint32_t* pointsPerType;
    /** Out. Number of distinct points of type 0: 1 or 0. */
    uint32_t numCenterPoints;
    /** Out. Number of distinct axial points: q (the number of vertices in an extreme vertices design), or 0. */
    uint32_t numAxialPoints;
    /** Out, [q], required. Entry d: number of faces of dimension d of the region within the bounds. */
    uint32_t* boundaryCounts;
    /** In, 1 after creation. How often each point of type 1 is run; 0 leaves them out. */
    uint32_t vertexReplicates;
    /** In, [q-2]. Entry t-2: how often each point of type t is run, for t = 2..q-1; read only when q > 2. Null, the
     * value after creation, means once each. */
    const uint32_t* typeReplicates;
    /** In, 1 after creation. How often the overall centroid is run. */
    uint32_t centerReplicates;
    /** In, 1 after creation. How often each axial point is run. */
    uint32_t axialReplicates;
    /** In, 1 after creation. How often the whole set of replicated points is repeated. */
    uint32_t designReplicates;
    /** 0 after creation; not read. */
    uint32_t reserved;
    /** In, 0 after creation. Number of two-level process variables with which the mixture runs are crossed. */
    uint32_t numProcessVariables;
    /** In, 1 after creation. Denominator of the fraction of the process factorial: 1, 2, 4, 8 or 16. */
    uint32_t processFraction;
    /** In, 1 after creation. Which of the fractions to run, 1..processFraction; the last is the principal one. */
    uint32_t fractionIndex;
    /** In, 0 after creation. Number of total amounts; 2 or more make a mixture-amount experiment. */
    uint32_t numAmounts;
    /** In, [numAmounts]. The totals; the first scales the bounds. Not read when numAmounts is 0. */
    const double* amounts;
    /** In, flag. Nonzero adds axial points. */
    uint8_t axialPoints;
    /** Out, flag. 1 when a bound was tightened, else 0. */
    uint8_t boundsAdjusted;
    /** In, 0 after creation. One of the des_Units... constants. */
    uint32_t outputUnits;
    /** In, flag. Nonzero randomizes the run order. */
    uint8_t randomize;
    /** In, 0.0 after creation. Seed of the randomization, as in des_DefinitiveScreeningDesign. */
    double seed;
    /** Out. Number of records in `runs`. */
    uint32_t numRuns;
    /** Out, [numRuns]. The runs in standard order, allocated by the library. A second run on the same record replaces
     * the pointer without freeing the first array: use a new container for each run. */
    des_MixtureRun* runs;
} des_MixtureDesign;

/** @brief A linear constraint lowerValue <= coefficients . x <= upperValue on the components x.
 *
 * Record and coefficients belong to the caller. */
typedef struct des_MixtureDesignLinearConstraint {
    /** In, flag. Nonzero when the lower side holds. Zero makes the constraint an upper one, whatever hasUpperValue
     * says. */
    uint8_t hasLowerValue;
    /** In. Lower side, in the units of the total. Minus infinity means no limit; NaN is refused. */
    double lowerValue;
    /** In, flag. Read only when hasLowerValue is nonzero: nonzero when the upper side holds as well. */
    uint8_t hasUpperValue;
    /** In. Upper side, likewise. */
    double upperValue;
    /** In, [q], required, finite. Coefficient of each component. */
    const double* coefficients;
    /** Out. 1: the lower side does not cut the region. 2: the upper side does not. 3: neither side of a two-sided
     * constraint does. Left as the caller set it when every side cuts. */
    int32_t status;
} des_MixtureDesignLinearConstraint;

/**
 * @brief A new mixture design record with the defaults that its fields name, and no arrays.
 * @return to be handed to des_DeleteMixtureDesignContainer(); null when there is no memory
 * @since 0.1
 */
REISTI_API des_MixtureDesign* des_CreateMixtureDesignContainer(void);

/**
 * @brief Frees the runs of a record and the record, and sets the caller's pointer to null.
 *
 * Frees none of the caller's arrays. `runs` and `numRuns` have to be as a run function, or creation, left them.
 *
 * @param design may be null or point to null: then nothing happens
 * @since 0.1
 */
REISTI_API void des_DeleteMixtureDesignContainer(des_MixtureDesign** design);

/**
 * @brief Builds a simplex centroid design: the centroids of all 2^q-1 subsets of the components.
 *
 * Source: H. Scheffe, "The simplex-centroid design for experiments with mixtures", J. Royal Statistical Society B 25
 * (1963) 235-251. Bounds have to leave a region that is itself a simplex; the design is built in its
 * L-pseudo-components.
 *
 * On an error, what the fields of the record tell as outputs is undefined except as said here: `runs` and `numRuns` are
 * untouched by an error found before the runs are counted (all of the codes below except a late des_ErrorOutOfMemory,
 * which leaves null and 0, and a late des_ErrorProcessFraction, for more than 7 process variables or a fraction that
 * the catalog lacks, which leaves the runs with process levels 0). Bounds stay divided by the total, and as far as they
 * were tightened.
 *
 * @param design a record from des_CreateMixtureDesignContainer()
 * @retval des_ErrorNullPointer        design or a required array is null; nothing changed
 * @retval des_ErrorAmountsAndProcess  2 amounts or more together with process variables; nothing changed
 * @retval des_ErrorProcessFraction    the fraction is not allowed for the number of process variables
 * @retval des_ErrorLowerBoundSum      the lower bounds sum to the total or more
 * @retval des_ErrorUpperBoundSum      the upper bounds sum to the total or less
 * @retval des_ErrorUpperBound         an upper bound is above the total
 * @retval des_ErrorEmptyRange         a component's range is at most 1e-5 of its upper bound
 * @retval des_ErrorNotSimplex         the bounded region is not a simplex
 * @retval des_ErrorOutOfMemory        out of memory, or more runs than 32 bits can count
 * @retval des_Success                 the design is complete
 * @since 0.1
 */
REISTI_API int32_t des_RunSimplexCentroidDesign(des_MixtureDesign* design);

/**
 * @brief Builds a {q, degree} simplex lattice design: all mixtures whose proportions are multiples of 1/degree.
 *
 * Source: H. Scheffe, "Experiments with mixtures", J. Royal Statistical Society B 20 (1958) 344-360.
 *
 * @param design      a record from des_CreateMixtureDesignContainer()
 * @param degree      at least 1, and at most 10 for q <= 5, 7 for q = 6, 6 for q = 7, 5 for q = 8, 4 for q <= 11, 3 for
 *                    q <= 17, 2 for q <= 20; without limit for more components
 * @param centerPoint flag: nonzero adds the overall centroid where it is not already a point of the lattice
 * @retval des_ErrorDegree the degree is not allowed; nothing changed
 * @return otherwise the codes of des_RunSimplexCentroidDesign(), with the same state left behind
 * @since 0.1
 */
REISTI_API int32_t des_RunSimplexLatticeDesign(des_MixtureDesign* design, int32_t degree, uint8_t centerPoint);

/**
 * @brief Builds an extreme vertices design on the region that bounds and linear constraints leave.
 *
 * Source: R. A. McLean and V. L. Anderson, "Extreme vertices design of mixture experiments", Technometrics 8 (1966)
 * 447-454. Points are the vertices of the region, then the centroids of its edges, of its two-dimensional faces and so
 * on up to dimension degree-1, then on request the overall centroid (the mean of the vertices) and one axial point for
 * each vertex, halfway to that centroid.
 *
 * @param design         a record from des_CreateMixtureDesignContainer()
 * @param degree         1: vertices only; k: also the centroids of faces up to dimension k-1; at most q. 0 is accepted
 *                       and gives vertices only
 * @param centerPoint    flag: nonzero adds the overall centroid, where degree is below q
 * @param numConstraints number of constraints; a negative number counts as 0
 * @param constraints    [numConstraints] the caller's constraints, whose `status` is written; may be null when there
 *                       are none
 * @param maxPoints      most vertices and centroids together that the caller accepts, looked at as centroids are added:
 *                       vertices alone never exceed it; 0 or negative for no limit
 * @retval des_ErrorDegree        degree is negative or above q; nothing changed
 * @retval des_ErrorNullPointer   also when constraints are missing or one has no coefficients; nothing changed
 * @retval des_ErrorNotANumber    a constraint holds NaN or an infinite coefficient; nothing changed. Or a bound is not
 *                                finite after the bounds were checked
 * @retval des_ErrorTooManyPoints more points than maxPoints; bounds may have been tightened and statuses written
 * @return otherwise the codes of des_RunSimplexCentroidDesign() except des_ErrorNotSimplex, with the same state left
 *         behind
 * @since 0.1
 */
REISTI_API int32_t des_RunExtremeVerticesDesign(des_MixtureDesign* design, int32_t degree, uint8_t centerPoint,
                                                int32_t numConstraints, des_MixtureDesignLinearConstraint* constraints,
                                                int32_t maxPoints);

/* ---------------------------------------------------------------------------------------------------------------- */
/* Fractional factorial catalog                                                                                     */
/* ---------------------------------------------------------------------------------------------------------------- */

/** @brief A two-level factorial design, or a regular fraction of one, from which process variables are laid out.
 *
 * Factors are named A to H and J to P in order; the first log2(numRuns) are the base factors. */
typedef struct des_FractionalFactorial {
    /** Number of factors. */
    int32_t numFactors;
    /** Number of runs, a power of two. */
    int32_t numRuns;
    /** Resolution of the fraction; 0 for a full factorial. */
    int32_t resolution;
    /** Largest number of blocks; 0 when the design cannot be blocked. */
    int32_t maxBlocks;
    /** Words separated by blanks, one for each factor behind the base factors: the product that defines it. */
    const char* generators;
    /** Words separated by blanks: the first makes 2 blocks, the next two 4, the next three 8, and so on. */
    const char* blockGenerators;
} des_FractionalFactorial;

/**
 * @brief The catalog of two-level designs that process fractions are taken from.
 * @param[out] count receives the number of entries; may be null
 * @return [count] by number of runs, then of factors; static storage, never null
 * @since 0.1
 */
REISTI_API const des_FractionalFactorial* des_FractionalFactorialCatalog(uint32_t* count);

#ifdef __cplusplus
}
#endif

#endif
