/* SPDX-License-Identifier: MIT */
#ifndef STUB_SETJMP_H
#define STUB_SETJMP_H
typedef long jmp_buf[8];
#define setjmp(buffer) stub_setjmp(buffer)
#endif
