/* SPDX-License-Identifier: MIT */
#ifndef STUB_SYS_IOCTL_H
#define STUB_SYS_IOCTL_H
#include <asm-generic/ioctl.h>
int ioctl(int file, unsigned long request, ...);
#endif
