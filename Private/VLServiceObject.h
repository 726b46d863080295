// VLServiceObject: the part that RealTimeBrowse, StreamAPI and DownloadAPI share. A service
// object is its proxy (a SOAP context) bound to the client handle's settings: it owns the
// endpoint URL and builds the header blocks of every request. The three differ only in their
// proxy, their service file and the kind of device-settings header block.
//
// Life: constructed with its handle; Setup_SSL_Client_CACerts; SetParams once; then any number
// of calls, each Setup(operation) + the operation + the caller's release of the call's records
// (the header lives in the context's memory and goes with them, so every call runs Setup again).
#ifndef VLSERVICEOBJECT_H
#define VLSERVICEOBJECT_H

#include "VLAssert.h"
#include "VLSoapProxy.h"
#include "VLString.h"
#include "VL_WS_SetupParams2.h"

// The steps that do not depend on the kind of service (defined in VLServiceObject.cpp).
namespace VLServiceBinding {
// SetParams, after the precondition: endpoint = ServiceBaseURL + serviceFile; the HTTP proxy
// (only when ProxyHost is not empty; user and password only when not empty); the User-Agent;
// send and connect time-out SendTimeout, receive time-out RecvTimeout; the proxy's endpoint
// pointer; the WS-Addressing and then the WS-Security plug-in.
void Bind(VLSoapProxy* proxy, const VL_WS_SetupParams2& params, const char* serviceFile, VLString* endpoint);
// Setup, up to the device-settings block: a new header with "wsa:MessageID" "uuid:<operation>",
// "wsa:To" the endpoint, "wsa:Action" the API namespace URI + operation, "wsa:ReplyTo" the
// anonymous address, and the UsernameToken "User" with the password digest. Returns the
// context's error code.
int AddRequestHeader(VLSoapProxy* proxy, const VL_WS_SetupParams2& params, const VLString& endpoint,
                     const VLString& operation);
}  // namespace VLServiceBinding

// Proxy: the service's proxy class; Block: its device-settings record, made by NewBlock (the
// generated soap_new_set_<Block>) and put into the header slot Slot.
template <class Proxy, class Block, Block* (*NewBlock)(soap*, char*, char*, int, char*, char*),
          Block* SOAP_ENV__Header::*Slot>
class VLServiceObject : public Proxy {
 public:
  virtual ~VLServiceObject() {}

  // Binds the object to the handle's settings, which must outlive it. Once per object.
  void SetParams(const VL_WS_SetupParams2* params) {
    VL_ASSERT(params != 0);
    VL_ASSERT(m_Params == 0);
    m_Params = params;
    VLServiceBinding::Bind(this, *params, m_ServiceFile, &m_Endpoint);
  }

  // Prepares the header blocks of the next call of the named operation (its SOAP name, for
  // example "getTitlesByNavigation"). The settings' strings are referenced, so the block carries
  // their values at this moment. Returns the context's error code (SOAP_OK).
  int Setup(const VLString& operation) {
    VL_ASSERT(m_Params != 0);
    int rc = VLServiceBinding::AddRequestHeader(this, *m_Params, m_Endpoint, operation);
    if (rc != SOAP_OK) return rc;
    const VL_WS_SetupParams2& p = *m_Params;
    Block* block = NewBlock(this, const_cast<char*>(p.APIKey.c_str()), const_cast<char*>(p.DestinationUniqueID.c_str()),
                            p.DestinationTypeID, const_cast<char*>(p.AuthToken.c_str()), NULL);
    if (!block) return this->error = SOAP_EOM;
    this->header->*Slot = block;
    return SOAP_OK;
  }

  // The endpoint URL (empty before SetParams).
  const VLString& Endpoint() const { return m_Endpoint; }

 protected:
  explicit VLServiceObject(const char* serviceFile) : m_Params(0), m_ServiceFile(serviceFile) {}

 private:
  const VL_WS_SetupParams2* m_Params;  // borrowed; null until SetParams
  VLString m_Endpoint;
  const char* m_ServiceFile;
};

#endif  // VLSERVICEOBJECT_H
