#include "DownloadAPI.h"

DownloadAPI::DownloadAPI() : VLServiceObject("DownloadAPI.asmx") {}

DownloadAPI::~DownloadAPI() {}
