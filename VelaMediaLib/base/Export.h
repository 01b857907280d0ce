#pragma once
// What the shared library shows a host. The library is built with hidden
// visibility: only what carries these marks is exported.
//
// VELAMEDIALIB_API            classes and free functions of the interface.
// VELAMEDIALIB_TEMPLATE_API   class templates: their instantiations (typeinfo,
//                             vtables, members) are shared with the host.
//                             Empty for Windows DLLs, which export only
//                             explicit instantiations.
// VELAMEDIALIB_EXTERN_TEMPLATE   the declaration of an instantiation the
//                             library builds once (extern template class).
//                             It also exports instantiations over types of
//                             hidden visibility, such as Boost's pointers.
// VELAMEDIALIB_INSTANTIATION  the definition of that instantiation.
//
// The library target defines VELAMEDIALIB_BUILDING; a static build defines
// VELAMEDIALIB_STATIC for itself and its hosts.

#if defined(VELAMEDIALIB_STATIC)
#define VELAMEDIALIB_API
#define VELAMEDIALIB_TEMPLATE_API
#define VELAMEDIALIB_EXTERN_TEMPLATE
#define VELAMEDIALIB_INSTANTIATION
#elif defined(_WIN32) || defined(__CYGWIN__)
#if defined(VELAMEDIALIB_BUILDING)
#define VELAMEDIALIB_API __declspec(dllexport)
#else
#define VELAMEDIALIB_API __declspec(dllimport)
#endif
#define VELAMEDIALIB_TEMPLATE_API
#define VELAMEDIALIB_EXTERN_TEMPLATE VELAMEDIALIB_API
#define VELAMEDIALIB_INSTANTIATION VELAMEDIALIB_API
#elif defined(__GNUC__) || defined(__clang__)
#define VELAMEDIALIB_API __attribute__((visibility("default")))
#define VELAMEDIALIB_TEMPLATE_API __attribute__((visibility("default")))
#define VELAMEDIALIB_EXTERN_TEMPLATE __attribute__((visibility("default")))
#define VELAMEDIALIB_INSTANTIATION
#else
#define VELAMEDIALIB_API
#define VELAMEDIALIB_TEMPLATE_API
#define VELAMEDIALIB_EXTERN_TEMPLATE
#define VELAMEDIALIB_INSTANTIATION
#endif
