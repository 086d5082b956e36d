# The application's own link needs: libpng and libqrencode for the QR pictures, the
# supplicant's control client (static, from libwpa-client-dev) for the Wi-Fi link.
find_package(PNG REQUIRED)
find_library(FTX_QRENCODE_LIB qrencode REQUIRED)
find_library(FTX_WPA_CLIENT_LIB NAMES libwpa_client.a wpa_client REQUIRED)
target_link_libraries(ftxapp PUBLIC PNG::PNG ${FTX_QRENCODE_LIB} ${FTX_WPA_CLIENT_LIB})
