// vlstore-sim: runs the store simulator in the foreground until SIGINT or SIGTERM.
#include <signal.h>

#include <cstdio>
#include <cstdlib>
#include <cstring>
#include <fstream>
#include <iostream>
#include <string>

#include "VLSimServer.h"

namespace {

const int kExitStartFailed = 1;
const int kExitUsage = 2;
const int kExitPortInUse = 3;

void Usage(std::ostream& out) {
  out << "usage: vlstore-sim [options]\n"
         "Serves the store's SOAP services and HTTP endpoints for every store host on two local ports\n"
         "and prints the settings a client needs (SSL_CERT_FILE, VLWS_CONNECT_TO).\n"
         "\n"
         "  --bind ADDR            IPv4 address to listen on (default 127.0.0.1)\n"
         "  --tls-port N           HTTPS port (default 0: any free port)\n"
         "  --http-port N          plain HTTP port (default 0: any free port)\n"
         "  --cert-dir DIR         write the test CA (ca.pem) there (default: a temporary folder)\n"
         "  --data-dir DIR         the sample store's data files (default: the repository's simulator/data)\n"
         "  --env-file FILE        also write the two export lines to FILE\n"
         "  --user NAME            WS-Security user name (default vlsim-user)\n"
         "  --password TEXT        WS-Security password (default vlsim-password)\n"
         "  --api-key KEY          API key of the device-settings header (default VLSIM-API-KEY)\n"
         "  --clock-skew SECONDS   accepted distance of wsu:Created from the clock (default 300)\n"
         "  --fault SPEC           inject a fault, TARGET=MODE[:ARG][,times=N] (repeatable), e.g.\n"
         "                         getTitlesByNavigation=status:503  /device/time/=delay:2000\n"
         "                         getConfig=code:4,times=1  " "stg.ostrel.example=tls:wronghost\n"
         "                         modes: delay:MS close cut status:N soapfault[:client|server] code:N\n"
         "                         malformed truncated gzip deflate badlength[:D] trickle:MS\n"
         "                         tls:selfsigned|wronghost|expired\n"
         "  --device-env ID=DIGIT  the environment digit /device/env/ answers for a device (repeatable)\n"
         "  --default-env DIGIT    the digit for every other device (default 2)\n"
         "  --access-type N        File_AccessType of getFileType: 0, 1 (download) or 2 (stream, default)\n"
         "  --cache-load-time TEXT what getLastCacheLoadTimeUTC answers\n"
         "  --probe-bytes N        size of the bandwidth probe file (default 1000000)\n"
         "  --return-timeout S     seconds ReturnTimeout holds its answer (default 100)\n"
         "  --quiet                do not print a line per request\n"
         "  --help                 this text\n"
         "\n"
         "Exit status: 0 after SIGINT or SIGTERM, 1 when the simulator cannot start, 2 for bad options,\n"
         "3 when a port is in use.\n";
}

bool ParseNumber(const char* text, long low, long high, long* value) {
  char* end = nullptr;
  long number = strtol(text, &end, 10);
  if (!*text || *end || number < low || number > high) return false;
  *value = number;
  return true;
}

int BadOption(const std::string& message) {
  std::cerr << "vlstore-sim: " << message << "\n(vlstore-sim --help lists the options)\n";
  return kExitUsage;
}

}  // namespace

int main(int argc, char** argv) {
  VLSimOptions options;
  options.printRequests = true;
  std::string envFile, cacheLoadTime;
  std::vector<std::pair<std::string, int>> deviceEnvs;
  long defaultEnv = -1, accessType = -1;

  for (int i = 1; i < argc; ++i) {
    std::string option = argv[i];
    if (option == "--help" || option == "-h") {
      Usage(std::cout);
      return 0;
    }
    if (option == "--quiet") {
      options.printRequests = false;
      continue;
    }
    if (i + 1 >= argc) return BadOption("option " + option + " needs a value");
    const char* value = argv[++i];
    long number = 0;
    if (option == "--bind") options.bindAddress = value;
    else if (option == "--cert-dir") options.certFolder = value;
    else if (option == "--data-dir") options.dataFolder = value;
    else if (option == "--env-file") envFile = value;
    else if (option == "--user") options.userName = value;
    else if (option == "--password") options.password = value;
    else if (option == "--api-key") options.apiKey = value;
    else if (option == "--fault") options.faults.push_back(value);
    else if (option == "--cache-load-time") cacheLoadTime = value;
    else if (option == "--tls-port" || option == "--http-port") {
      if (!ParseNumber(value, 0, 65535, &number)) return BadOption(option + " needs a port number 0 to 65535");
      (option == "--tls-port" ? options.tlsPort : options.httpPort) = static_cast<int>(number);
    } else if (option == "--clock-skew" || option == "--probe-bytes" || option == "--return-timeout") {
      if (!ParseNumber(value, 1, 100000000, &number)) return BadOption(option + " needs a positive number");
      if (option == "--clock-skew") options.clockSkewSeconds = static_cast<int>(number);
      else if (option == "--probe-bytes") options.probeBytes = static_cast<int>(number);
      else options.returnTimeoutSeconds = static_cast<int>(number);
    } else if (option == "--default-env") {
      if (!ParseNumber(value, 0, 9, &defaultEnv)) return BadOption("--default-env needs a digit");
    } else if (option == "--access-type") {
      if (!ParseNumber(value, 0, 2, &accessType)) return BadOption("--access-type needs 0, 1 or 2");
    } else if (option == "--device-env") {
      const char* equals = strrchr(value, '=');
      if (!equals || equals == value || !ParseNumber(equals + 1, 0, 9, &number))
        return BadOption("--device-env needs ID=DIGIT");
      deviceEnvs.push_back({std::string(value, equals - value), static_cast<int>(number)});
    } else {
      return BadOption("unknown option " + option);
    }
  }
  for (const std::string& spec : options.faults) {
    VLSimFault fault;
    std::string error;
    if (!VLSimFault::Parse(spec, &fault, &error)) return BadOption(error);
  }

  // The server's threads inherit this mask; the main thread waits for the signals below.
  sigset_t signals;
  sigemptyset(&signals);
  sigaddset(&signals, SIGINT);
  sigaddset(&signals, SIGTERM);
  pthread_sigmask(SIG_BLOCK, &signals, nullptr);

  VLSimServer server(options);
  std::string error;
  if (!server.Start(&error)) {
    std::cerr << "vlstore-sim: " << error << "\n";
    return server.AddressInUse() ? kExitPortInUse : kExitStartFailed;
  }
  VLSimStore& store = server.Store();
  for (const auto& device : deviceEnvs) store.SetDeviceEnv(device.first, device.second);
  if (defaultEnv >= 0) store.SetDefaultEnv(static_cast<int>(defaultEnv));
  if (accessType >= 0) store.SetAccessType(static_cast<int>(accessType));
  if (!cacheLoadTime.empty()) store.SetLastCacheLoadTime(cacheLoadTime);

  if (!envFile.empty()) {
    std::ofstream out(envFile);
    out << server.EnvironmentSettings();
    if (!out) {
      std::cerr << "vlstore-sim: cannot write " << envFile << "\n";
      server.Stop();
      return kExitStartFailed;
    }
  }
  std::cout << "vlstore-sim: serving the store on " << options.bindAddress << ", TLS port " << server.TlsPort()
            << ", HTTP port " << server.HttpPort() << "\n"
            << "WS-Security user \"" << options.userName << "\", password \"" << options.password
            << "\", API key \"" << options.apiKey << "\"\n"
            << "Client settings:\n"
            << server.EnvironmentSettings() << std::flush;

  int received = 0;
  sigwait(&signals, &received);
  std::cout << "vlstore-sim: " << (received == SIGINT ? "SIGINT" : "SIGTERM") << ", stopping" << std::endl;
  server.Stop();
  return 0;
}
