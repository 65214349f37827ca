/* What tour.c offers to the test. */
#ifndef ORN_HDL_TESTS_TOUR_H
#define ORN_HDL_TESTS_TOUR_H

#include <stddef.h>

#ifdef __cplusplus
extern "C" {
#endif

/** Makes a small design and looks at it. \return 0 when everything went well. */
int RunTour(char* result, size_t size);

#ifdef __cplusplus
}
#endif

#endif
