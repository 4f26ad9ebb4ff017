/*
 * libkrrt: a host for krnumer.
 *
 * krnumer never owns the arrays that it reads and fills; it asks its host to resize them. A program without a host of
 * its own links libkrrt and has one: krnumer finds the loaded library by itself, nothing is to be initialised.
 *
 *     KrHandle x = KrrtNewArray(KRRT_DOUBLE, 100);
 *     double* samples = (double*)KrrtElements(x);
 *     ...
 *     KrrtFree(x);
 *
 * For tests the host can place elements as badly as the contract allows, move blocks at every resize, refuse memory
 * at a given call, tell the calls it saw, and count what was not given back.
 *
 * Threads: everything may be called from several threads at once on different handles. The settings for tests and
 * the calls seen belong to the calling thread, and every thread starts with the defaults. The counts of live blocks
 * and of stale writes belong to the process.
 */
#ifndef KRRT_KRRT_H
#define KRRT_KRRT_H

#include <krnumer/types.h>

#if !defined(_WIN32)
#define KRRT_EXPORT __attribute__((visibility("default")))
#elif defined(KRRT_BUILD)
#define KRRT_EXPORT __declspec(dllexport)
#else
#define KRRT_EXPORT __declspec(dllimport)
#endif

#if defined(__cplusplus)
#define KRRT_API extern "C" KRRT_EXPORT
#else
#define KRRT_API KRRT_EXPORT
#endif

/* Type codes of elements. */
#define KRRT_INT32 3    /**< int32_t */
#define KRRT_UINT8 5    /**< uint8_t */
#define KRRT_UINT32 7   /**< uint32_t */
#define KRRT_DOUBLE 10  /**< double */
#define KRRT_COMPLEX 13 /**< KrComplex */

/* Status of the services, unless a test asked for another. */
#define KRRT_OK 0
#define KRRT_BAD_ARGUMENT 1  /**< null handle, unknown type code, rank other than 1 or 2, negative size */
#define KRRT_OUT_OF_MEMORY 2 /**< the memory cannot be had, or lies beyond the limit set by KrrtBlockLimit */

/* ---- Arrays ------------------------------------------------------------------------------------------------- */

/**
 * Creates an array with all elements 0 and its dimension words set.
 *
 * Elements start at a 64-byte boundary, and the block therefore 4, 8 or 12 bytes before one.
 *
 * @return the handle, or null when the type code is unknown, a dimension negative or the memory not to be had
 */
KRRT_API KrHandle KrrtNewArray(int32_t typeCode, int32_t size);
KRRT_API KrHandle KrrtNewMatrix(int32_t typeCode, int32_t rows, int32_t columns);
KRRT_API KrHandle KrrtNewCube(int32_t typeCode, int32_t pages, int32_t rows, int32_t columns);

/** Creates a 1-D array of packed records, all bytes 0. Records have no type code; they cannot be resized by one. */
KRRT_API KrHandle KrrtNewRecords(int32_t recordBytes, int32_t count);

/** Frees an array; null is nothing. */
KRRT_API void KrrtFree(KrHandle handle);

/** Number of dimensions, 1 to 3; 0 for a block from MakeBlock. */
KRRT_API int32_t KrrtRank(KrHandle handle);

/** Dimension word `dimension`, counted from 0; 0 where the array has no such dimension. */
KRRT_API int32_t KrrtSize(KrHandle handle, int32_t dimension);

/** Overwrites a dimension word and nothing else, as a caller with a malformed array would. */
KRRT_API void KrrtSetSize(KrHandle handle, int32_t dimension, int32_t size);

/** First element; for a block from MakeBlock its first byte. Valid until the next resize. */
KRRT_API void* KrrtElements(KrHandle handle);

/** Bytes of the block, dimension words included. */
KRRT_API uint64_t KrrtBytes(KrHandle handle);

/* ---- The services that krnumer calls ------------------------------------------------------------------------ */

/**
 * Resizes the block of `*handle` to `numDims` dimension words and `totalElements` elements.
 *
 * Contents up to the lesser size stay. The block may move. Dimension words are the caller's business, and what the
 * block gains is not initialised.
 *
 * @param typeCode      one of the type codes above, whatever the array was created with
 * @param numDims       1 or 2
 * @param handle        address of the handle; the handle itself stays
 * @param totalElements product of all dimensions
 * @return 0, or another status with the block as it was; less memory than before is always to be had
 */
KRRT_API int32_t ResizeNumberBlock(int32_t typeCode, int32_t numDims, KrHandle* handle, int32_t totalElements);

/**
 * Registers `procedure(data)` with the calling thread's current instance, to be called once when it is closed.
 *
 * @param mode when to call; krnumer passes 2, the end of the instance, and this host knows no other moment
 */
KRRT_API void HookCleanup(void (*procedure)(void* data), void* data, int32_t mode);

/** Creates a block of bytes, not initialised, at a 64-byte boundary. Null for a negative size or without memory. */
KRRT_API KrHandle MakeBlock(int32_t bytes);

/** Resizes a block of bytes; contents up to the lesser size stay. 0, or another status with the block as it was. */
KRRT_API int32_t SizeBlock(KrHandle handle, int32_t bytes);

/** Frees a block of bytes; null is nothing. */
KRRT_API void DropBlock(KrHandle handle);

/* ---- Instances ---------------------------------------------------------------------------------------------- */

/** A caller of krnumer: what was registered with HookCleanup ends with it. */
typedef struct KrrtInstance KrrtInstance;

/** Opens an instance. It becomes current only by KrrtUseInstance. Null when the memory is not to be had. */
KRRT_API KrrtInstance* KrrtOpenInstance(void);

/**
 * Calls the clean-ups of an instance, the latest first, then ends it.
 *
 * No thread but the calling one may still use it; there the default instance takes its place. Null stands for the
 * default instance, whose clean-ups run but which stays open. They also run at the end of the process; a program
 * that unloads krnumer before has to close the default instance first.
 */
KRRT_API void KrrtCloseInstance(KrrtInstance* instance);

/** Makes an instance, or with null the default one, current in the calling thread; returns the former. */
KRRT_API KrrtInstance* KrrtUseInstance(KrrtInstance* instance);

/** The calling thread's current instance; null is the default instance. */
KRRT_API KrrtInstance* KrrtCurrentInstance(void);

/** Clean-ups registered with an instance (null: the default one) and not yet called. */
KRRT_API int32_t KrrtPendingCleanups(KrrtInstance* instance);

/* ---- For tests: settings of the calling thread -------------------------------------------------------------- */

/**
 * 1: blocks created or resized from now on have their elements at an odd multiple of 4 bytes, the least alignment
 * that the contract allows. 0, the default: at a multiple of 64. Returns the former setting.
 */
KRRT_API int32_t KrrtLeastAlignment(int32_t on);

/**
 * 1: every resize moves the block, even to the same size. What the block gains, and all of a block that MakeBlock
 * gives, is filled with the byte 0xC3. The old block is filled with 0xA5 and kept until the array is resized again or
 * freed, when writes to it are noticed (KrrtStaleWrites). 0, the default: blocks move only when they have to. Returns
 * the former setting.
 */
KRRT_API int32_t KrrtMovingBlocks(int32_t on);

#define KRRT_FRESH_BYTE 0xC3 /**< what a moving block gains */
#define KRRT_STALE_BYTE 0xA5 /**< what a moving block leaves behind */

/** Refuses any block of more than `bytes` bytes; 0, the default, for no limit. Returns the former limit. */
KRRT_API uint64_t KrrtBlockLimit(uint64_t bytes);

/* The calls that KrrtFail counts. */
#define KRRT_RESIZES 0 /**< every ResizeNumberBlock, the emptying ones included */
#define KRRT_SIZINGS 1 /**< ResizeNumberBlock to more than 0 elements */
#define KRRT_BLOCKS 2  /**< MakeBlock, which then returns null, and SizeBlock */

/**
 * Lets the `nth` call from now fail, once, with `status`; nth 1 is the next call. The block stays as it is. Each of
 * the three ways of counting has its own order, and a new order replaces the last. nth 0 takes it back.
 */
KRRT_API void KrrtFail(int32_t calls, int32_t nth, int32_t status);

/** Calls still to come until the ordered failure, its own included; 0 when none is ordered or it has happened. */
KRRT_API int32_t KrrtFailurePending(int32_t calls);

/* ---- For tests: what the host saw --------------------------------------------------------------------------- */

/** One call of ResizeNumberBlock. */
typedef struct KrrtResize {
    int32_t typeCode;
    int32_t numDims;
    int32_t totalElements;
    int32_t status; /**< what the host returned */
    KrHandle handle;
} KrrtResize;

/** Calls of ResizeNumberBlock by the calling thread since it last called KrrtForgetResizes. */
KRRT_API int32_t KrrtResizeCount(void);

/** Copies call `index`, counted from 0. Returns 1, or 0 when there is no such call or it is not among the last 64. */
KRRT_API int32_t KrrtResizeCall(int32_t index, KrrtResize* call);

/** Sets the count of resizes to 0. */
KRRT_API void KrrtForgetResizes(void);

/** Arrays and blocks of the whole process that were created and not freed. */
KRRT_API int64_t KrrtLiveBlocks(void);

/** Abandoned blocks (KrrtMovingBlocks) that were written to after the resize that moved them, in the whole process. */
KRRT_API int64_t KrrtStaleWrites(void);

/* ---- Texts -------------------------------------------------------------------------------------------------- */

/** What a status of krnumer or of this host means, in English; a static text, never null. */
KRRT_API const char* KrrtStatusText(int32_t status);

#endif
