/* SPDX-License-Identifier: MIT */
#ifndef STUB_STDINT_H
#define STUB_STDINT_H
typedef signed char int8_t;
typedef short int16_t;
typedef int int32_t;
typedef long int64_t;
typedef unsigned char uint8_t;
typedef unsigned short uint16_t;
typedef unsigned int uint32_t;
typedef unsigned long uint64_t;
#define UINT32_C(c) c##U
#define UINT64_C(c) c##UL
#define UINT32_MAX 4294967295U
#define UINT64_MAX UINT64_C(18446744073709551615)
#endif
