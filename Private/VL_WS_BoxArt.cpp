// Box art of the client: VL_WS_getBoxArtImage (a local file name or the image's URL) and
// VL_WS_getBoxArtImageData (the image's bytes), with the cache's BoxArt rows and, for a file
// cache, the image files beside the database.
#include <string.h>

#include "BoxArtDownloader.h"
#include "VLFile.h"
#include "VLProxySuspension.h"
#include "VLRecord.h"
#include "VLUtilities.h"
#include "VL_WS.h"
#include "VL_WS_Call.h"

namespace {

// One image asked of a client: its cache row, and the downloads that fill or revalidate it.
// Every download goes through the catalogue context, without its proxy.
class BoxArtRequest {
 public:
  BoxArtRequest(VL_WS_Client* client, const char* prefix, VL_WS_BoxArtSize size)
      : m_Client(client),
        m_Prefix(prefix),
        m_Size(size),
        m_Proxy(client->m_RealTimeBrowse),
        m_Downloader(&client->m_RealTimeBrowse),
        m_CacheType(kNoCache),
        m_RowSize(0),
        m_NeedUpdate(0) {
    const VL_WS_CacheParam2& cache = client->m_Params.CacheParam;
    if (client->m_Cache != 0 && (cache.CacheData & VL_WS_CacheParam::CACHE_BOXART)) m_CacheType = cache.CacheType;
    // A prefix with a path separator would name a file outside the cache folder: such an image
    // is never kept in a file.
    if (m_CacheType == kFileCache && strchr(prefix, VLFile::PATH_SEPERATOR) != 0) m_CacheType = kNoCache;
    if (m_CacheType == kFileCache)
      m_FileName = VLUtilities::GetBoxArtImageFileName(cache.CachePath.c_str(), prefix, size);
  }

  int CacheType() const { return m_CacheType; }
  const VLString& FileName() const { return m_FileName; }

  // For a file cache: true when the image's file is there, after revalidating it when its row
  // asks for that, or after downloading it when it is not (or is no image).
  bool LocalFile() {
    if (ReadRow() && VLUtilities::IsJpegFile(m_FileName)) {
      Revalidate(0);
      return true;
    }
    return Download(false, 0) == VL_WS_OK;
  }

  // The image from the cache (revalidated when its row asks for that) into image; false when the
  // cache has no usable copy: none, or one that is no image.
  bool AnswerFromCache(VL_WS_Image& image) {
    if (m_CacheType == kNoCache || !ReadRow()) return false;
    if (m_CacheType == kFileCache) {
      if (!VLUtilities::IsJpegFile(m_FileName)) return false;
      Revalidate(0);
      return VLUtilities::SetImageByFile(image, m_FileName);
    }
    if (!VLUtilities::IsJpegImage(m_Data)) return false;
    VLString fresh;
    VLUtilities::SetImageByData(image, Revalidate(&fresh) == VL_WS_OK ? fresh : m_Data);
    return true;
  }

  // Downloads the image into image (and into the cache); the download's status.
  VL_WS_Status DownloadImage(VL_WS_Image& image) {
    VLString data;
    VL_WS_Status status = Download(false, &data);
    if (status != VL_WS_OK) return status;
    if (m_CacheType != kFileCache) {
      VLUtilities::SetImageByData(image, data);
      return VL_WS_OK;
    }
    return VLUtilities::SetImageByFile(image, m_FileName) ? VL_WS_OK : VL_WS_E_FILE;
  }

 private:
  bool ReadRow() { return m_Client->m_Cache->ReadBoxArt(m_Prefix, m_Size, m_RowSize, m_LastModified, m_NeedUpdate, m_Data); }

  // A conditional download of a stored image whose row asks for it (see Download); 304 when
  // there is nothing to do.
  VL_WS_Status Revalidate(VLString* data) {
    return m_NeedUpdate ? Download(true, data) : static_cast<VL_WS_Status>(VL_WS_E_HTTP_NOT_MODIFIED);
  }

  // Downloads the image to the cache file (file cache) or into data, conditional on the row's
  // Last-Modified when conditional. A new image replaces the cache row; a "304 Not Modified"
  // keeps the row and clears its NeedUpdate.
  VL_WS_Status Download(bool conditional, VLString* data) {
    VLString since = conditional ? m_LastModified : VLString();
    VL_WS_Status status = m_CacheType == kFileCache ? m_Downloader.DownloadToFile(m_Prefix, m_Size, since, m_FileName)
                                                    : m_Downloader.DownloadToBuffer(m_Prefix, m_Size, since, *data);
    if (m_CacheType == kNoCache) return status;
    if (status == VL_WS_OK) {
      m_Client->m_Cache->WriteBoxArt(m_Prefix, m_Size, m_Downloader.GetContentLength(), m_Downloader.GetLastModified(),
                                     0, m_CacheType == kFileCache ? VLString() : *data);
    } else if (status == VL_WS_E_HTTP_NOT_MODIFIED) {
      m_Client->m_Cache->WriteBoxArt(m_Prefix, m_Size, m_RowSize, m_LastModified, 0, m_Data);
      m_NeedUpdate = 0;
    }
    return status;
  }

  VL_WS_Client* m_Client;
  VLString m_Prefix;
  VL_WS_BoxArtSize m_Size;
  VLProxySuspension m_Proxy;
  BoxArtDownloader m_Downloader;
  int m_CacheType;  // the cache's type when it stores box art, else kNoCache
  VLString m_FileName;

  // The cache row, once read.
  unsigned int m_RowSize;
  VLString m_LastModified;
  unsigned int m_NeedUpdate;
  VLString m_Data;
};

// A box-art request names an image: a prefix and one of the sizes.
bool ValidImage(const char* prefix, VL_WS_BoxArtSize size) {
  return prefix != 0 && *prefix != 0 && *VLUtilities::BoxArtSize2ImageSize(size) != 0;
}

}  // namespace

extern "C" VL_WS_Status VL_WS_getBoxArtImage(VL_WS_Handle* handle, VL_WS_BoxArtSize size, const char* prefix,
                                             VL_WS_String* location) {
  VL_WS_Client* client = VLClientFor(handle, location);
  if (client == 0 || !ValidImage(prefix, size)) return VL_WS_E_INVALID_ARGUMENT;

  BoxArtRequest request(client, prefix, size);
  if (request.CacheType() == kFileCache && request.LocalFile()) {
    VLRecordSetString(*location, request.FileName().c_str());
  } else {
    // The user interface loads the image itself.
    VLRecordSetString(*location, VLUtilities::GetBoxArtImageURL(prefix, size).c_str());
  }
  return VL_WS_OK;
}

extern "C" VL_WS_Status VL_WS_getBoxArtImageData(VL_WS_Handle* handle, VL_WS_BoxArtSize size, const char* prefix,
                                                 VL_WS_Image* image) {
  VL_WS_Client* client = VLClientFor(handle, image);
  if (client == 0 || !ValidImage(prefix, size)) return VL_WS_E_INVALID_ARGUMENT;

  BoxArtRequest request(client, prefix, size);
  if (request.AnswerFromCache(*image)) return VL_WS_OK;
  return request.DownloadImage(*image);
}
