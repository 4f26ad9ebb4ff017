/*
 * Status codes of krnumer.
 *
 * 0 is success. A code from -20999 to -20001 is a failure: array outputs are empty and scalar outputs are NaN unless
 * the function says otherwise. A code from 20001 to 20999 is a warning: the results stand. Any other value is a
 * status of the host, handed on from a resize that failed.
 */
#ifndef KRNUMER_STATUS_H
#define KRNUMER_STATUS_H

enum KrStatus {
    KRN_OK = 0,

    KRN_OUT_OF_MEMORY = -20001,    /**< memory could not be had, from the host or from the C run time */
    KRN_SIZES_DIFFER = -20002,     /**< two inputs that belong together differ in length or in dimensions */
    KRN_EMPTY_INPUT = -20003,      /**< an input array is empty, or a count is less than 1 */
    KRN_NEGATIVE_LENGTH = -20004,  /**< the length word of an array of samples is negative */
    KRN_NO_SAMPLE = -20005,        /**< a length less than 1 where one sample at least is needed */
    KRN_FEWER_THAN_TWO = -20006,   /**< two samples, points or coefficients at least are needed */
    KRN_FEWER_THAN_THREE = -20007, /**< three points at least are needed */
    KRN_BAD_DIMENSION = -20008,    /**< a dimension is negative, or an array is too small for the method chosen */
    KRN_TOO_LONG = -20010,         /**< an input is longer than 8388608 samples */
    KRN_BAD_DUTY = -20011,         /**< the duty cycle is not positive */
    KRN_BAD_CYCLES = -20012,       /**< the number of cycles is not positive, or more than the samples can show */
    KRN_BAD_WIDTH = -20013, /**< the width of a peak is outside 1 to n - 1, or there are fewer samples than the width */
    KRN_PULSE_DOES_NOT_FIT = -20014, /**< delay or width of a pulse is negative, or the pulse ends behind the pattern */
    KRN_BAD_SAMPLING_INTERVAL = -20016, /**< the sampling interval or a sample time is not positive */
    KRN_BAD_INDEX = -20017,             /**< an index lies outside its array */
    KRN_CUTOFF_ABOVE_NYQUIST = -20020,  /**< a cutoff lies above half the sampling frequency */
    KRN_BAD_ORDER = -20021,             /**< an order or a count is less than 1; a polynomial is constant */
    KRN_BAD_DECIMATION = -20022,        /**< the decimating factor is less than 1 or more than the length */
    KRN_BAD_FREQUENCY =
        -20023, /**< the sampling frequency or a cutoff is not positive, or the low cutoff is not below the high one */
    KRN_BAD_RIPPLE = -20024,               /**< the ripple is not positive */
    KRN_BAD_ATTENUATION = -20025,          /**< the attenuation is not positive */
    KRN_ZERO_SIGMA = -20026,               /**< sigma is 0 in a Gaussian fit */
    KRN_BAD_FINAL_VALUE = -20027,          /**< the final value of an exponential window is not positive */
    KRN_ATTENUATION_BELOW_RIPPLE = -20028, /**< the stopband attenuation is not above the passband ripple */
    KRN_BAD_BANDS = -20031, /**< band edges or weights of an equiripple design cannot be used, or the exchange failed */
    KRN_BAD_RANK = -20032,  /**< the rank of a median filter is negative */
    KRN_EVEN_LENGTH = -20033,        /**< a number of taps or a length that has to be odd is even */
    KRN_MIXED_SIGNS = -20036,        /**< the data of a logarithmic fit have mixed signs */
    KRN_UNDERDETERMINED = -20037,    /**< more unknowns than observations */
    KRN_INNER_SIZES_DIFFER = -20039, /**< the inner dimensions of a product differ */
    KRN_NOT_SQUARE = -20040,         /**< a matrix that has to be square is not */
    KRN_SINGULAR = -20041,           /**< a matrix is singular */
    KRN_TOO_FEW_LEVELS = -20042,     /**< a factor of an analysis of variance has fewer than 2 levels */
    KRN_BAD_LEVEL = -20043,          /**< the level code of an observation is outside 0 to levels - 1 */
    KRN_EMPTY_CELL =
        -20044, /**< a cell of the design holds no observation, or the observations per cell are not positive */
    KRN_BAD_DATA_COUNT = -20045,    /**< the number of observations is not the product of levels and replications */
    KRN_HISTORY_TOO_SMALL = -20046, /**< the history of a stream exceeds its buffer */
    KRN_UNBALANCED = -20047,        /**< the design of an analysis of variance is not balanced */
    KRN_NO_FREEDOM_LEFT = -20048,   /**< the design leaves no degree of freedom, or its model is not allowed */
    KRN_REPEATED_ABSCISSA = -20049, /**< abscissas repeat, or a value under a logarithm is not positive */
    KRN_INTERPOLANT_POLE = -20050,  /**< the rational interpolant has a pole at the point */
    KRN_BAD_FREEDOM = -20052,       /**< the degrees of freedom are out of range */
    KRN_BAD_PROBABILITY = -20053,   /**< a probability or a level of confidence is outside 0 to 1 */
    KRN_TABLE_TOO_SMALL =
        -20055, /**< a contingency table has fewer than 2 rows or columns; more than one x is 0 in a robust line */
    KRN_NEGATIVE_CELL = -20056,  /**< a contingency table has a negative dimension or a negative cell */
    KRN_NEGATIVE_STATE = -20059, /**< the start position or the history count of a stream is negative */
    KRN_ZERO_BASE =
        -20060, /**< zero to the power zero, the reciprocal of zero, or the logarithm of a zero eigenvalue */
    KRN_BAD_SELECTOR = -20061,   /**< a selector is outside its values */
    KRN_NO_CONVERGENCE = -20062, /**< an iteration did not converge within its limit */
    KRN_BAD_COEFFICIENT =
        -20063, /**< a coefficient of a polynomial cannot be used; the order of a smoothing polynomial is less than 1 */
    KRN_NO_STATE = -20064, /**< a stream goes on without the state of its first block */
    KRN_BAD_COEFFICIENT_COUNT =
        -20066, /**< the coefficient arrays of a filter do not have the lengths that order and type ask for */
    KRN_NOT_FINITE = -20068,           /**< the data hold a NaN or an infinity */
    KRN_TOO_FEW_FOR_GAUSSIAN = -20069, /**< a Gaussian fit or its bounds have too few points */
    KRN_PENCIL_SIZES_DIFFER =
        -20070, /**< the matrices of a pencil, or a band matrix and its right-hand side, do not match */
    KRN_NOT_POSITIVE_DEFINITE = -20071,      /**< a matrix is not positive definite */
    KRN_REORDERING_FAILED = -20073,          /**< the eigenvalues of a Schur form could not be reordered */
    KRN_REORDERING_ILL_CONDITIONED = -20074, /**< the reordered Schur form changed its eigenvalues */
    KRN_TOO_MANY_TAPS =
        -20075,                /**< a resampler has more taps than its buffer; a robust fit ran out of its sort stack */
    KRN_OUTPUT_FULL = -20076,  /**< a resampler reached the capacity of its output */
    KRN_NOT_PROVIDED = -20078, /**< the operation is declared but not provided */
    KRN_NO_SPREAD = -20101,    /**< the lower bound of a histogram is not below its upper bound */
    KRN_NEGATIVE_ORDER = -20103,  /**< the order of a polynomial is negative */
    KRN_HOLDS_NA_N = -20104,      /**< the data or an argument of a distribution are NaN */
    KRN_ZERO_POLYNOMIAL = -20111, /**< all coefficients of a polynomial are 0 */
    KRN_NO_CHANNEL = -20115,      /**< a number of channels or of transforms is less than 1 */
    KRN_NOT_POSITIVE = -20140,    /**< a parameter that has to be positive is not */
    KRN_ZERO_PARAMETER = -20141,  /**< a parameter that has to differ from 0 is 0 */

    KRN_TOO_FEW_TRANSITIONS = -20308,       /**< measurement: the list holds too few transitions */
    KRN_FLAT_HISTOGRAM = -20309,            /**< measurement: the histogram is flat */
    KRN_TOO_FEW_CROSSINGS = -20310,         /**< measurement: too few level crossings */
    KRN_MEASUREMENT_OUT_OF_MEMORY = -20311, /**< measurement: memory could not be had */
    KRN_NO_SAMPLES = -20312,                /**< measurement: no samples */
    KRN_LEVELS_OUT_OF_ORDER = -20313,       /**< measurement: the reference levels are out of order */
    KRN_BAD_UNITS = -20314,                 /**< measurement: unknown units of the levels */
    KRN_BAD_MEASUREMENT_INTERVAL = -20315,  /**< measurement: the sampling interval is not positive */
    KRN_BAD_STATE_METHOD = -20316,          /**< measurement: unknown method for the state levels */
    KRN_NO_BINS = -20317,                   /**< measurement: fewer than 1 histogram bin */
    KRN_RESULT_NOT_FINITE = -20318,         /**< measurement: the result is not finite */
    KRN_NO_PERIOD = -20319,                 /**< measurement: no period */
    KRN_UNKNOWN_CONTEXT = -20321,           /**< measurement: unknown identifier of a context */
    KRN_BAD_OCCURRENCE = -20323,            /**< measurement: the occurrence is less than 1 */
    KRN_ALREADY_PRESENT = -20324,           /**< measurement: the object is there already */
    KRN_UNEXPECTED_KIND = -20325,           /**< measurement: a kind that the object does not serve */
    KRN_ZERO_TRANSITION = -20326,           /**< measurement: the transition takes no time */
    KRN_EXCEPTION_CAUGHT = -20327,          /**< measurement: an exception was caught at the boundary */
    KRN_NULL_MARKERS = -20329,              /**< measurement: null pointer to the marker box */
    KRN_NULL_RESULT = -20330,               /**< measurement: null pointer to the result */
    KRN_NULL_RECORD = -20331,               /**< measurement: null pointer to a parameter record */
    KRN_LAPACK_ERROR = -20999,              /**< LAPACK reported an argument or internal error */

    KRN_WARN_RANK_DEFICIENT = 20001,     /**< the least-squares problem is rank deficient */
    KRN_WARN_EMPTY_POLYNOMIAL = 20002,   /**< the root finder was given an empty polynomial */
    KRN_WARN_ZERO_PIVOT = 20003,         /**< a triangular factor has a zero pivot */
    KRN_WARN_SIZES_DIFFER = 20004,       /**< two inputs differ in length, and the shorter length was used */
    KRN_WARN_NOT_REORDERED = 20005,      /**< the order of the generalised eigenvalues was given up */
    KRN_WARN_INACCURATE = 20006,         /**< the matrix function is inaccurate */
    KRN_WARN_INITIAL_IGNORED = 20010,    /**< initial coefficients of the wrong size were ignored */
    KRN_WARN_INITIAL_NOT_FINITE = 20030, /**< initial coefficients that are not finite were ignored */
};

#endif
