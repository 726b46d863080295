#include "RealTimeBrowse.h"

RealTimeBrowse::RealTimeBrowse() : VLServiceObject("RealTimeBrowse.asmx") {}

RealTimeBrowse::~RealTimeBrowse() {}
