// VLSimContext: what the request handlers of one simulator share — its settings, the sample
// store, the changing store state, the faults to inject, the request log and the stop signal.
// Internal to the simulator library.
#ifndef VLSIMCONTEXT_H
#define VLSIMCONTEXT_H

#include <time.h>

#include <map>
#include <memory>
#include <mutex>
#include <string>
#include <vector>

#include "VLSimCatalogue.h"
#include "VLSimFaults.h"
#include "VLSimHttp.h"
#include "VLSimRequestLog.h"
#include "VLSimServer.h"
#include "VLSimStore.h"

struct VLSimContext {
  VLSimOptions options;
  VLSimCatalogue catalogue;
  std::unique_ptr<VLSimStore> store;
  VLSimFaults faults;
  VLSimRequestLog log;
  VLSimStopSignal stop;
  // Nonces of accepted UsernameTokens with their created times: a nonce is accepted once.
  std::mutex nonceMutex;
  std::map<std::string, time_t> nonces;
};

// The three SOAP services, by the file name under the API path.
enum class VLSimService { kRealTimeBrowse, kStreamAPI, kDownloadAPI };

// Routes one request by scheme, Host header, method and path, and answers it. Fills the log
// entry; faults receives the transport faults the sender must still apply.
VLSimHttpResponse VLSimHandleRequest(VLSimContext& context, const VLSimHttpRequest& request, bool tls,
                                     VLSimRequest* entry, std::vector<VLSimFault>* faults);

// Answers a SOAP request to one of the services (VLSimSoap.cpp).
VLSimHttpResponse VLSimServeSoap(VLSimContext& context, const VLSimHttpRequest& request, VLSimService service,
                                 VLSimRequest* entry, std::vector<VLSimFault>* faults);

#endif  // VLSIMCONTEXT_H
