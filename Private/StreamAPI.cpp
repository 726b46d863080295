#include "StreamAPI.h"

StreamAPI::StreamAPI() : VLServiceObject("StreamAPI.asmx") {}

StreamAPI::~StreamAPI() {}
