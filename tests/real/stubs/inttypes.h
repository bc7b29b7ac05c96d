/* SPDX-License-Identifier: MIT */
#ifndef STUB_INTTYPES_H
#define STUB_INTTYPES_H
#include <stdint.h>
#define PRIu32 "u"
#define PRIu64 "lu"
#endif
