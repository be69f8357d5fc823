/* Operating-system glue of the CMPI declarations: thread, mutex and export
 * types as a Linux/x86_64 provider and broker see them. */
#ifndef _CMPIOS_H_
#define _CMPIOS_H_

#if !defined(CMPI_PLATFORM_LINUX_GENERIC_GNU) && defined(__linux__)
#  define CMPI_PLATFORM_LINUX_GENERIC_GNU 1
#endif
#ifndef CMPI_PLATFORM_LINUX_GENERIC_GNU
#  error "These CMPI declarations describe Linux only: define CMPI_PLATFORM_LINUX_GENERIC_GNU"
#endif

#include <pthread.h>
#include <stddef.h>

#define CMPI_THREAD_RETURN void*
#define CMPI_THREAD_TYPE void*
#define CMPI_MUTEX_TYPE void*
#define CMPI_COND_TYPE void*
#define CMPI_THREAD_KEY_TYPE pthread_key_t

#ifdef __cplusplus
/* __cdecl means nothing to g++ on x86_64; it only keeps code that names it
 * compiling. */
#  ifndef __cdecl
#    define __cdecl
#  endif
#  define CMPI_THREAD_CDECL __cdecl
#else
#  define CMPI_THREAD_CDECL
#endif

#if defined(__GNUC__) && __GNUC__ >= 4
#  define CMPI_EXPORT __attribute__((visibility("default")))
#else
#  define CMPI_EXPORT
#endif

#ifdef __cplusplus
#  define CMPI_EXTERN_C extern "C" CMPI_EXPORT
#else
#  define CMPI_EXTERN_C CMPI_EXPORT
#endif

#endif
