#include "BoxArtDownloader.h"

#include <string.h>

#include "VLAssert.h"
#include "VLFile.h"
#include "VLHttpGet.h"
#include "VLUtilities.h"

namespace {

// A conditional download of an image that has not changed answers "304 Not Modified".
const VLHttpGet::Kind kImage = {false, VL_WS_E_UNEXPECTED, VL_WS_E_HTTP_NOT_FOUND, VL_WS_E_HTTP_NOT_MODIFIED};

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
    if (status == VL_WS_OK && !VLUtilities::IsJpegImage(target)) status = VL_WS_E_NETWORK;
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
    if (status == VL_WS_OK && !VLUtilities::IsJpegFile(temporary)) status = VL_WS_E_NETWORK;
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
  VLString fields;
  if (!ifModifiedSince.empty()) fields = "If-Modified-Since: " + ifModifiedSince + "\r\n";
  VLHttpGet get(m_Soap);  // closes its connection on every way out
  VL_WS_Status status = get.Get(VLUtilities::GetBoxArtImageURL(prefix.c_str(), size).c_str(), kImage, fields);
  if (status != VL_WS_OK) return status;
  // No image is that large: such a length would only fill the disk or the memory.
  if (get.ContentLength() > kMaxContentLength) return VL_WS_E_NETWORK;
  *length = static_cast<unsigned int>(get.ContentLength());
  get.Field("Last-Modified", lastModified);

  // Body bytes of the first piece beyond the announced length are not the image's.
  size_t done = get.BodyReceived();
  if (!sink.Put(get.Body(), done)) return VL_WS_E_FILE;
  char buffer[VLHttpGet::kPieceSize];
  while (done < *length) {
    size_t want = *length - done < sizeof(buffer) ? *length - done : sizeof(buffer);
    size_t got = get.Receive(buffer, want);
    if (got == 0) return VL_WS_E_NETWORK;
    if (!sink.Put(buffer, got)) return VL_WS_E_FILE;
    done += got;
  }
  return VL_WS_OK;
}
