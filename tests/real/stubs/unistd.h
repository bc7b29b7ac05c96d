/* SPDX-License-Identifier: MIT */
#ifndef STUB_UNISTD_H
#define STUB_UNISTD_H
#include <sys/types.h>
#endif
