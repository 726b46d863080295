#include "BoxArtDownloader.h"

#include <string.h>

#include "VLAssert.h"
#include "VLFile.h"
#include "VLStoreHosts.h"
#include "VLTransportConnection.h"
#include "VLUtilities.h"

namespace {

const char kStatusOK[] = "HTTP/1.1 200 OK\r\n";

// The value of the header field name between fields, which starts at the end of the status line
// ("\r\n"), and end, the header's blank line: the text between "\r\n<name>: " and the end of
// that line. False when the header has no such field.
bool FieldValue(const char* fields, const char* end, const char* name, VLString* value) {
  VLString key = VLString("\r\n") + name + ": ";
  const char* found = strstr(fields, key.c_str());
  if (found == 0 || found >= end) return false;
  const char* text = found + key.length();
  value->assign(text, strstr(text, "\r\n") - text);
  return true;
}

// A "Content-Length" of decimal digits from 1 to the largest image; false for anything else.
bool ParseContentLength(const VLString& text, unsigned int* length) {
  if (text.empty() || text.length() > 10) return false;
  unsigned long long n = 0;
  for (size_t i = 0; i < text.length(); ++i) {
    if (text[i] < '0' || text[i] > '9') return false;
    n = n * 10 + (text[i] - '0');
  }
  if (n < 1 || n > BoxArtDownloader::kMaxContentLength) return false;
  *length = static_cast<unsigned int>(n);
  return true;
}

// Reads the header of an answer from its first piece (terminated): the status, and for
// "200 OK" the length, the last-modified value and where the body starts in the piece.
VL_WS_Status ParseHeader(const char* piece, unsigned int* length, VLString* lastModified, const char** body) {
  const char* status = strstr(piece, kStatusOK);
  if (status == 0) {
    if (strstr(piece, "HTTP/1.1 404 Not Found\r\n")) return VL_WS_E_HTTP_NOT_FOUND;
    if (strstr(piece, "HTTP/1.1 304 Not Modified\r\n")) return VL_WS_E_HTTP_NOT_MODIFIED;
    return VL_WS_E_NETWORK;
  }
  const char* fields = status + strlen(kStatusOK) - 2;
  const char* end = strstr(fields, "\r\n\r\n");
  if (end == 0) return VL_WS_E_NETWORK;  // the header did not fit into the first piece
  VLString value;
  if (FieldValue(fields, end, "Last-Modified", &value)) *lastModified = value;
  if (!FieldValue(fields, end, "Content-Length", &value) || !ParseContentLength(value, length))
    return VL_WS_E_NETWORK;
  *body = end + 4;
  return VL_WS_OK;
}

}  // namespace

// Where the image's bytes go: appended to a string or written to an open file.
class BoxArtDownloader::Sink {
 public:
  explicit Sink(VLString* data) : m_Data(data), m_File(0) {}
  explicit Sink(VLFile* file) : m_Data(0), m_File(file) {}

  bool Put(const char* bytes, size_t n) {
    if (m_File) return m_File->Write(bytes, static_cast<vl_int64>(n)) == static_cast<vl_int64>(n);
    m_Data->append(bytes, n);
    return true;
  }

 private:
  VLString* m_Data;
  VLFile* m_File;
};

BoxArtDownloader::BoxArtDownloader(soap* context) : m_Soap(context), m_ContentLength(0) {}

BoxArtDownloader::~BoxArtDownloader() {}

VL_WS_Status BoxArtDownloader::Download(const VLString& prefix, VL_WS_BoxArtSize size,
                                        const VLString& ifModifiedSince, bool toFile, VLString& target) {
  VL_ASSERT(m_Soap != 0);
  m_ContentLength = 0;
  m_LastModified = VLString();
  unsigned int length = 0;
  VLString lastModified;

  VL_WS_Status status;
  if (!toFile) {
    target = VLString();
    Sink sink(&target);
    status = Fetch(prefix, size, ifModifiedSince, sink, &length, &lastModified);
    if (status != VL_WS_OK) target = VLString();
  } else {
    VLString temporary = VLFile::CreateTempFileName(target.c_str());
    if (temporary.empty()) return VL_WS_E_FILE;
    VLFile file;
    status = file.Open(temporary.c_str(), "wb") ? VL_WS_OK : VL_WS_E_FILE;
    if (status == VL_WS_OK) {
      Sink sink(&file);
      status = Fetch(prefix, size, ifModifiedSince, sink, &length, &lastModified);
    }
    if (!file.Close() && status == VL_WS_OK) status = VL_WS_E_FILE;
    // rename replaces the destination in one step: a handle sharing the cache folder finds
    // either image, never none.
    if (status == VL_WS_OK && !VLFile::Rename(temporary.c_str(), target.c_str())) status = VL_WS_E_FILE;
    if (status != VL_WS_OK) VLFile::Remove(temporary.c_str());
  }
  if (status == VL_WS_OK) {
    m_ContentLength = length;
    m_LastModified = lastModified;
  }
  return status;
}

VL_WS_Status BoxArtDownloader::DownloadToBuffer(const VLString& prefix, VL_WS_BoxArtSize size,
                                                const VLString& ifModifiedSince, VLString& data) {
  return Download(prefix, size, ifModifiedSince, false, data);
}

VL_WS_Status BoxArtDownloader::DownloadToFile(const VLString& prefix, VL_WS_BoxArtSize size,
                                              const VLString& ifModifiedSince, const VLString& filename) {
  VLString target(filename);
  return Download(prefix, size, ifModifiedSince, true, target);
}

VL_WS_Status BoxArtDownloader::Fetch(const VLString& prefix, VL_WS_BoxArtSize size, const VLString& ifModifiedSince,
                                     Sink& sink, unsigned int* length, VLString* lastModified) {
  VLString path = VLUtilities::GetBoxArtImagePath(prefix.c_str(), size);
  VLTransportConnection connection(m_Soap);  // closed on every way out
  if (!connection.Open(VLUtilities::GetBoxArtImageURL(prefix.c_str(), size).c_str(), VL_STORE_IMAGE_HOST, 80))
    return VL_WS_E_CONNECT;
  VLString line = "GET " + path + " HTTP/1.1\r\n";
  if (!connection.Send(line.c_str(), line.length())) return VL_WS_E_NETWORK;
  if (!ifModifiedSince.empty()) {
    line = "If-Modified-Since: " + ifModifiedSince + "\r\n";
    if (!connection.Send(line.c_str(), line.length())) return VL_WS_E_NETWORK;
  }
  if (!connection.Send("User-Agent: DUDUVud\r\nHost: " VL_STORE_IMAGE_HOST "\r\n\r\n")) return VL_WS_E_NETWORK;

  char buffer[2048];
  size_t received = connection.Receive(buffer, sizeof(buffer) - 1);
  if (received == 0) return VL_WS_E_NETWORK;
  buffer[received] = 0;
  const char* body = 0;
  VL_WS_Status status = ParseHeader(buffer, length, lastModified, &body);
  if (status != VL_WS_OK) return status;

  // The first piece may hold more than the announced body: the rest is not the image's.
  size_t done = received - (body - buffer);
  if (done > *length) done = *length;
  if (!sink.Put(body, done)) return VL_WS_E_FILE;
  while (done < *length) {
    size_t want = *length - done < sizeof(buffer) ? *length - done : sizeof(buffer);
    size_t got = connection.Receive(buffer, want);
    if (got == 0) return VL_WS_E_NETWORK;
    if (!sink.Put(buffer, got)) return VL_WS_E_FILE;
    done += got;
  }
  return VL_WS_OK;
}
