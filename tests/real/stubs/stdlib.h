/* SPDX-License-Identifier: MIT */
#ifndef STUB_STDLIB_H
#define STUB_STDLIB_H
#include <stddef.h>
void* malloc(size_t size);
void free(void* memory);
#endif
