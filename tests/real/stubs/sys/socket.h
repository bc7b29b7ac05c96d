/* SPDX-License-Identifier: MIT */
#ifndef STUB_SYS_SOCKET_H
#define STUB_SYS_SOCKET_H
#define AF_INET 2
#define PF_INET AF_INET
struct sockaddr;
#endif
