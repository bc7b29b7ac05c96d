/* SPDX-License-Identifier: MIT */
#ifndef STUB_SYS_TYPES_H
#define STUB_SYS_TYPES_H
#include <stddef.h>
typedef long off_t;
typedef long ssize_t;
#endif
