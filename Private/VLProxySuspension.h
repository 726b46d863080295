// VLProxySuspension: clears a SOAP context's HTTP proxy for its scope and restores it at the end,
// whatever way the scope is left. Box-art images and the bandwidth probe are fetched from their
// hosts directly, never through the handle's proxy.
#ifndef VLPROXYSUSPENSION_H
#define VLPROXYSUSPENSION_H

#include "stdsoap2.h"

class VLProxySuspension {
 public:
  explicit VLProxySuspension(soap& context) : m_Soap(context), m_ProxyHost(context.proxy_host) {
    context.proxy_host = 0;
  }
  ~VLProxySuspension() { m_Soap.proxy_host = m_ProxyHost; }
  VLProxySuspension(const VLProxySuspension&) = delete;
  VLProxySuspension& operator=(const VLProxySuspension&) = delete;

 private:
  soap& m_Soap;
  const char* m_ProxyHost;
};

#endif  // VLPROXYSUSPENSION_H
