# Link needs of the GUI library inside ftxplatform: FreeType (text), libpng and zlib
# (bitmaps, screenshots), SDL2 (the desktop window). iconv is part of glibc.
find_package(Freetype REQUIRED)
find_package(PNG REQUIRED)
find_package(ZLIB REQUIRED)
pkg_check_modules(FTX_SDL2 REQUIRED IMPORTED_TARGET sdl2)
target_link_libraries(ftxplatform PRIVATE Freetype::Freetype PNG::PNG ZLIB::ZLIB PkgConfig::FTX_SDL2)
