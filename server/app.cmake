# The application's own link needs: libpng and libqrencode for the QR pictures, the
# supplicant's control client (static, from libwpa-client-dev) for the Wi-Fi link, libcurl
# (libcurl4-openssl-dev) for the aging record's upload.
find_package(PNG REQUIRED)
find_package(CURL REQUIRED)
find_library(FTX_QRENCODE_LIB qrencode REQUIRED)
find_library(FTX_WPA_CLIENT_LIB NAMES libwpa_client.a wpa_client REQUIRED)
target_link_libraries(ftxapp PUBLIC PNG::PNG CURL::libcurl ${FTX_QRENCODE_LIB}
  ${FTX_WPA_CLIENT_LIB})
