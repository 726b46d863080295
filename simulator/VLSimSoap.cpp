// VLSimSoap: one SOAP call of the simulated services. The generated server skeletons parse the
// request and write the answer; this file feeds them the received body, checks what a real store
// checks before any operation runs (the WS-Security UsernameToken digest, the SOAPAction, the
// device-settings block of the service and its API key), applies the SOAP-level faults and
// collects the answer for the HTTP sender.
#include <openssl/evp.h>
#include <string.h>

#include "VLSimSoap.h"
#include "VLStoreHosts.h"
#include "soapDownloadAPISoap12Service.h"
#include "soapRealTimeBrowseSoap12Service.h"
#include "soapStreamAPISoap12Service.h"

extern struct Namespace namespaces[];

namespace {

const char kPasswordDigest[] =
    "http://docs.oasis-open.org/wss/2004/01/oasis-200401-wss-username-token-profile-1.0#PasswordDigest";

// The generated services install soapcpp2's own namespace table whenever they dispatch; these
// keep the project's table, so answers declare the same namespaces as the store's.
#define VL_SIM_SERVICE_WITH_PROJECT_NAMESPACES(Name, Generated)          \
  class Name : public Generated {                                        \
   public:                                                               \
    using Generated::Generated;                                          \
    void Generated##_init(soap_mode imode, soap_mode omode) override {   \
      Generated::Generated##_init(imode, omode);                         \
      soap_set_namespaces(soap, namespaces);                             \
    }                                                                    \
  };

VL_SIM_SERVICE_WITH_PROJECT_NAMESPACES(RealTimeBrowseService, RealTimeBrowseSoap12Service)
VL_SIM_SERVICE_WITH_PROJECT_NAMESPACES(StreamService, StreamAPISoap12Service)
VL_SIM_SERVICE_WITH_PROJECT_NAMESPACES(DownloadService, DownloadAPISoap12Service)

// The bytes in and out of one call, and the status the runtime chose.
struct Exchange {
  VLSimCall call;
  const std::string* in = nullptr;
  size_t read = 0;
  std::string out;
  int status = 0;
};

Exchange& ExchangeOf(struct soap* soap) { return *static_cast<Exchange*>(VLSimCallOf(soap).exchange); }

size_t Receive(struct soap* soap, char* buffer, size_t size) {
  Exchange& exchange = ExchangeOf(soap);
  size_t n = std::min(size, exchange.in->size() - exchange.read);
  memcpy(buffer, exchange.in->data() + exchange.read, n);
  exchange.read += n;
  return n;
}

int Send(struct soap* soap, const char* data, size_t size) {
  ExchangeOf(soap).out.append(data, size);
  return SOAP_OK;
}

// The HTTP status line and headers are written by the simulator's sender, not by the runtime.
int Respond(struct soap* soap, int status, ULONG64) {
  ExchangeOf(soap).status = status;
  return SOAP_OK;
}

const char* ServiceName(VLSimService service) {
  switch (service) {
    case VLSimService::kRealTimeBrowse: return "RealTimeBrowse";
    case VLSimService::kStreamAPI: return "StreamAPI";
    default: return "DownloadAPI";
  }
}

const char* SettingsElement(VLSimService service) {
  switch (service) {
    case VLSimService::kRealTimeBrowse: return "VL1:DeviceSettings";
    case VLSimService::kStreamAPI: return "VL1:StreamDeviceRequestSettings";
    default: return "VL1:DownloadDeviceRequestSettings";
  }
}

template <typename Settings>
void ReadSettings(const Settings* settings, const char* element, VLSimCall* call) {
  if (!settings) return;
  VLSimRequest& entry = *call->entry;
  entry.settingsElement += (entry.settingsElement.empty() ? "" : ",") + std::string(element);
  entry.apiKey = settings->APIKey ? settings->APIKey : "";
  entry.hasAuthToken = settings->AuthToken != nullptr;
  entry.authToken = settings->AuthToken ? settings->AuthToken : "";
  entry.destinationUniqueID = settings->DestinationUniqueID ? settings->DestinationUniqueID : "";
  entry.destinationTypeID = settings->DestinationTypeID;
  call->deviceId = entry.destinationUniqueID;
  call->deviceType = entry.destinationTypeID;
  call->token = entry.authToken;
}

std::string Base64Sha1(const std::string& data) {
  unsigned char digest[EVP_MAX_MD_SIZE];
  unsigned int length = 0;
  EVP_Digest(data.data(), data.size(), digest, &length, EVP_sha1(), nullptr);
  unsigned char text[64];
  int n = EVP_EncodeBlock(text, digest, static_cast<int>(length));
  return std::string(reinterpret_cast<char*>(text), n);
}

// Checks the UsernameToken: the configured user, a password digest (never a clear password),
// SHA-1 over nonce, created time and password, a created time within the allowed skew of the
// real clock, and a nonce not seen before. Returns "ok" or the reason for refusing.
std::string Authenticate(struct soap* soap, VLSimContext& context) {
  const _wsse__UsernameToken* token =
      soap->header && soap->header->wsse__Security ? soap->header->wsse__Security->UsernameToken : nullptr;
  if (!token) return "no UsernameToken";
  if (!token->Username || context.options.userName != token->Username) return "unknown user name";
  if (!token->Password || !token->Password->__item || !token->Password->Type ||
      strcmp(token->Password->Type, kPasswordDigest) != 0)
    return "the password is not a digest";
  if (!token->Nonce || !token->Nonce->__item || !token->wsu__Created) return "nonce or created time missing";
  time_t created = 0;
  if (soap_s2dateTime(soap, token->wsu__Created, &created) != SOAP_OK) return "unreadable wsu:Created";
  time_t now = time(nullptr);
  if (created < now - context.options.clockSkewSeconds) return "stale wsu:Created";
  if (created > now + context.options.clockSkewSeconds) return "wsu:Created in the future";
  int nonceLength = 0;
  const char* nonce = soap_base642s(soap, token->Nonce->__item, nullptr, 0, &nonceLength);
  if (!nonce) return "unreadable nonce";
  std::string expected = Base64Sha1(std::string(nonce, nonceLength) + token->wsu__Created + context.options.password);
  if (expected != token->Password->__item) return "wrong password digest";
  std::lock_guard<std::mutex> lock(context.nonceMutex);
  for (auto it = context.nonces.begin(); it != context.nonces.end();)
    it = it->second < now - context.options.clockSkewSeconds ? context.nonces.erase(it) : std::next(it);
  if (!context.nonces.emplace(token->Nonce->__item, created).second) return "replayed nonce";
  return "ok";
}

// The checks before the operation: SOAP_OK, or the fault to answer (already set in soap).
int Check(struct soap* soap, VLSimCall& call, const std::string& operation) {
  VLSimRequest& entry = *call.entry;
  const SOAP_ENV__Header* header = soap->header;
  if (header) {
    entry.messageID = header->wsa__MessageID ? header->wsa__MessageID : "";
    entry.wsaAction = header->wsa__Action ? header->wsa__Action : "";
    entry.wsaTo = header->wsa__To ? header->wsa__To : "";
    if (header->wsse__Security && header->wsse__Security->UsernameToken &&
        header->wsse__Security->UsernameToken->Username)
      entry.userName = header->wsse__Security->UsernameToken->Username;
    ReadSettings(header->VL1__StreamDeviceRequestSettings_, "VL1:StreamDeviceRequestSettings", &call);
    ReadSettings(header->VL1__DeviceSettings_, "VL1:DeviceSettings", &call);
    ReadSettings(header->VL1__DownloadDeviceRequestSettings_, "VL1:DownloadDeviceRequestSettings", &call);
  }
  entry.authentication = Authenticate(soap, *call.context);
  if (entry.authentication != "ok")
    return soap_sender_fault_subcode(soap, "wsse:FailedAuthentication",
                                     "The security token could not be authenticated or authorized",
                                     ("<reason>" + entry.authentication + "</reason>").c_str());
  std::string action = VL_API_NAMESPACE + operation;
  if (entry.soapAction != action)
    return soap_sender_fault(soap, "The SOAPAction header does not name the operation of the body",
                             ("<expected>" + action + "</expected>").c_str());
  if (entry.settingsElement != SettingsElement(call.service))
    return soap_sender_fault(soap, "The request needs the device-settings header block of this service",
                             (std::string("<expected>") + SettingsElement(call.service) + "</expected>").c_str());
  if (entry.apiKey != call.context->options.apiKey)
    return soap_sender_fault(soap, "Invalid API key", nullptr);
  return SOAP_OK;
}

int Dispatch(struct soap* soap, VLSimService service) {
  switch (service) {
    case VLSimService::kRealTimeBrowse: {
      RealTimeBrowseService server(soap);
      return server.dispatch();
    }
    case VLSimService::kStreamAPI: {
      StreamService server(soap);
      return server.dispatch();
    }
    default: {
      DownloadService server(soap);
      return server.dispatch();
    }
  }
}

}  // namespace

int VLSimAccountOf(struct soap* soap) {
  VLSimCall& call = VLSimCallOf(soap);
  return call.token.empty() ? 0 : call.context->store->AccountForToken(call.token, call.deviceId);
}

VLSimHttpResponse VLSimServeSoap(VLSimContext& context, const VLSimHttpRequest& request, VLSimService service,
                                 VLSimRequest* entry, std::vector<VLSimFault>* faults) {
  Exchange exchange;
  exchange.call.context = &context;
  exchange.call.service = service;
  exchange.call.entry = entry;
  exchange.in = &request.body;
  exchange.call.exchange = &exchange;
  entry->service = ServiceName(service);
  entry->soapAction = request.Header("SOAPAction");
  if (entry->soapAction.size() >= 2 && entry->soapAction.front() == '"' && entry->soapAction.back() == '"')
    entry->soapAction = entry->soapAction.substr(1, entry->soapAction.size() - 2);

  struct soap* soap = soap_new1(SOAP_C_UTFSTRING);
  soap_set_namespaces(soap, namespaces);
  soap->user = &exchange.call;
  soap->frecv = Receive;
  soap->fsend = Send;
  soap->fresponse = Respond;

  bool runOperation = false;
  if (soap_begin_serve(soap) == SOAP_OK) {
    soap_peek_element(soap);
    std::string tag = soap->tag;
    std::string operation = tag.substr(tag.find(':') + 1);
    if (soap_match_tag(soap, soap->tag, ("VL1:" + operation).c_str()) == SOAP_OK) entry->operation = operation;
    *faults = context.faults.Take(entry->operation, request.path);
    if (Check(soap, exchange.call, entry->operation) == SOAP_OK) {
      runOperation = true;
      for (const VLSimFault& fault : *faults) {
        if (fault.mode == VLSimFault::kSoapFault) {
          if (fault.text == "client") soap_sender_fault(soap, "Fault injected by the simulator", nullptr);
          else soap_receiver_fault(soap, "Fault injected by the simulator", nullptr);
          runOperation = false;
        } else if (fault.mode == VLSimFault::kStatus) {
          runOperation = false;  // the store did not get to the operation
        } else if (fault.mode == VLSimFault::kCode) {
          exchange.call.forceCode = true;
          exchange.call.forcedCode = fault.arg;
        }
      }
      if (runOperation) {
        soap->header = nullptr;  // the answer carries no header blocks
        if (Dispatch(soap, service) != SOAP_OK && soap->error < SOAP_STOP) soap_send_fault(soap);
      }
    }
    if (!runOperation && soap->error != SOAP_OK) {
      soap->header = nullptr;
      soap_send_fault(soap);
    }
  }

  VLSimHttpResponse response;
  response.status = exchange.status == SOAP_OK || exchange.status == 200 ? 200 : 500;
  response.headers.push_back({"Content-Type", "text/xml; charset=utf-8"});
  response.body = exchange.out;
  soap_destroy(soap);
  soap_end(soap);
  soap_free(soap);
  return response;
}
