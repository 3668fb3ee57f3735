/* SPDX-License-Identifier: Apache-2.0 */
/* CMPI 2.0: what depends on the platform. A build defines CMPI_PLATFORM_LINUX_GENERIC_GNU. */
#ifndef CMPIPL_H_
#define CMPIPL_H_

#ifndef CMPI_PLATFORM_LINUX_GENERIC_GNU
#error "These CMPI headers know one platform: define CMPI_PLATFORM_LINUX_GENERIC_GNU"
#endif

#define CMPI_EXPORT __attribute__((visibility("default")))
#define CMPI_IMPORT

#ifdef __cplusplus
#define CMPI_EXTERN_C extern "C" CMPI_EXPORT
#else
#define CMPI_EXTERN_C CMPI_EXPORT
#endif

/* Threads, mutexes and conditions are the object manager's; a provider sees them as opaque handles. */
#define CMPI_THREAD_CDECL
#define CMPI_THREAD_RETURN void*
#define CMPI_THREAD_TYPE void*
#define CMPI_MUTEX_TYPE void*
#define CMPI_COND_TYPE void*
/* The first headers have eight bytes here; an object manager writes four, as every later one does. */
#define CMPI_THREAD_KEY_TYPE unsigned int

#endif /* CMPIPL_H_ */
