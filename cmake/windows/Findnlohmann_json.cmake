# Headers only, so the library of this machine serves Windows too.
include(HostHeaders)
gw_host_headers(nlohmann_json::nlohmann_json nlohmann)
set(nlohmann_json_FOUND TRUE)
