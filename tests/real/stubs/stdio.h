/* SPDX-License-Identifier: MIT */
#ifndef STUB_STDIO_H
#define STUB_STDIO_H
#include <stddef.h>
typedef struct stub_file FILE;
#define EOF (-1)
#define SEEK_SET 0
#define SEEK_CUR 1
#define SEEK_END 2
#define stderr stderr
int fprintf(FILE* file, const char* format, ...);
#endif
