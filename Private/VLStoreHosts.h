// VLStoreHosts.h: the store's host names. Every part of the library that names a store host
// (endpoint table, device-environment and time services, box-art images, the SOAP namespace URIs,
// the build's WSDL generation) takes it from here; nothing else spells a host name.
//
// They are macros so that compile-time tables (the SOAP namespace table, fallback endpoints) can
// be built from them by string-literal concatenation. soap/CMakeLists.txt reads
// VL_STORE_PRODUCTION_HOST from this file: keep each definition on one line.
#ifndef VL_STORE_HOSTS_H
#define VL_STORE_HOSTS_H

#define VL_STORE_PRODUCTION_HOST "store.ostrel.example"
#define VL_STORE_STAGING_HOST "stg.ostrel.example"
#define VL_STORE_STAGING_API_HOST "stgapi.ostrel.example"
#define VL_STORE_ADULT_PRODUCTION_HOST "adult.ostrel.example"
#define VL_STORE_ADULT_STAGING_HOST "stg.adult.ostrel.example"
#define VL_STORE_IMAGE_HOST "images.ostrel.example"

// The production host also serves the web site whose name is part of the API namespace URI, the
// device-environment query "/device/env/" and the server time "/device/time/".
#define VL_STORE_WEB_HOST VL_STORE_PRODUCTION_HOST

// Namespace of every element and type of the store's schema (VL1); it never changes with the
// environment a client talks to.
#define VL_API_NAMESPACE "http://" VL_STORE_WEB_HOST "/api/"

#endif  // VL_STORE_HOSTS_H
