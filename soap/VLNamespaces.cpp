// VLNamespaces.cpp: the namespace table of every SOAP context of the library (the three service
// proxies, the serializer and the server skeletons built from the same declarations).
//
// Written by hand because the wire format fixes its rows and their order: the envelope declares
// every prefix in this order, and soapcpp2's generated .nsmap tables differ (other order, rows of
// the imported WS-Security schemas, no VL5). The gSOAP runtime library refers to the global
// named `namespaces`, so the name is fixed as well. The third column is the pattern also
// accepted on input (so a SOAP 1.2 reply is read); the first row makes outgoing envelopes SOAP 1.1.
#include "stdsoap2.h"

#include "VLStoreHosts.h"

struct Namespace namespaces[] = {
    {"SOAP-ENV", "http://schemas.xmlsoap.org/soap/envelope/", "http://www.w3.org/*/soap-envelope", NULL},
    {"SOAP-ENC", "http://schemas.xmlsoap.org/soap/encoding/", "http://www.w3.org/*/soap-encoding", NULL},
    {"xsi", "http://www.w3.org/2001/XMLSchema-instance", "http://www.w3.org/*/XMLSchema-instance", NULL},
    {"xsd", "http://www.w3.org/2001/XMLSchema", "http://www.w3.org/*/XMLSchema", NULL},
    {"c14n", "http://www.w3.org/2001/10/xml-exc-c14n#", NULL, NULL},
    {"wsu", "http://docs.oasis-open.org/wss/2004/01/oasis-200401-wss-wssecurity-utility-1.0.xsd", NULL, NULL},
    {"ds", "http://www.w3.org/2000/09/xmldsig#", NULL, NULL},
    {"wsse", "http://docs.oasis-open.org/wss/2004/01/oasis-200401-wss-wssecurity-secext-1.0.xsd", NULL, NULL},
    {"wsa", "http://schemas.xmlsoap.org/ws/2004/08/addressing", NULL, NULL},
    {"VL2", VL_API_NAMESPACE "StreamAPISoap12", NULL, NULL},
    {"VL3", VL_API_NAMESPACE "RealTimeBrowseSoap12", NULL, NULL},
    {"VL4", VL_API_NAMESPACE "DownloadAPISoap12", NULL, NULL},
    {"VL1", VL_API_NAMESPACE, NULL, NULL},
    {"VL5", VL_API_NAMESPACE "DownloadAuthenticateSoap12", NULL, NULL},
    {NULL, NULL, NULL, NULL}};
