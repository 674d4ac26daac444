/* Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0 */

/* What the other CMPI headers need to know of the platform: linkage and calling convention. */

#ifndef CMPIPL_H
#define CMPIPL_H

#ifdef __cplusplus
#define CMPI_EXTERN_C extern "C"
#else
#define CMPI_EXTERN_C
#endif

/* The linkage of a provider's factory function: found by name, even in a library whose other
   symbols are hidden. */
#define CMPI_EXPORT __attribute__((visibility("default")))

#endif
