# Headers only, so the library of this machine serves Windows too.
include(HostHeaders)
gw_host_headers(CLI11::CLI11 CLI)
set(CLI11_FOUND TRUE)
