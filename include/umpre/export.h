// SPDX-License-Identifier: MIT
#ifndef UMPRE_EXPORT_H
#define UMPRE_EXPORT_H

/// @file
/// What is seen from outside.

/// Marks what the library lets others call; all the rest is hidden.
#define UMPRE_API __attribute__((visibility("default")))

#endif
