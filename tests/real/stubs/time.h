/* SPDX-License-Identifier: MIT */
#ifndef STUB_TIME_H
#define STUB_TIME_H
typedef long time_t;
struct tm;
#endif
