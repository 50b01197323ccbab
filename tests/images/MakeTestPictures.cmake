# Makes the test pictures with ImageMagick. Called as
#   cmake -DCONVERT=<convert> -DSOURCE=<tests/images> -DOUT=<folder> -P MakeTestPictures.cmake
# Each picture's size differs in width and height so that a reader that swaps them is caught.
file(MAKE_DIRECTORY "${OUT}")
# Debian's ImageMagick policy refuses sides above 16384 pixels; ours allows the wide pictures.
set(ENV{MAGICK_CONFIGURE_PATH} "${SOURCE}/data")

# picture([FORMAT:]name convert-arguments...): FORMAT names the file format where the extension alone does not.
function(picture name)
    string(REGEX MATCH "^[A-Z0-9]+:" format "${name}")
    string(REGEX REPLACE "^[A-Z0-9]+:" "" name "${name}")
    execute_process(COMMAND "${CONVERT}" ${ARGN} "${format}${OUT}/${name}" RESULT_VARIABLE failed)
    if(failed)
        message(FATAL_ERROR "ImageMagick could not make ${name}")
    endif()
endfunction()

# PNG of every colour type (0 grey, 2 RGB, 3 palette, 4 grey with alpha, 6 RGB with alpha).
picture(png-type0.png -size 100x80 gradient:black-white -define png:color-type=0)
picture(png-type2.png -size 240x90 gradient:red-blue -define png:color-type=2)
picture(png-type3.png -size 200x300 gradient:red-blue -colors 16 -define png:color-type=3)
picture(png-type4.png -size 240x180 gradient:black-white -alpha set -channel A -evaluate set 50% -define png:color-type=4)
picture(png-type6.png -size 640x480 gradient:red-blue -alpha set -channel A -evaluate set 50% -define png:color-type=6)
picture(picture.gif -size 16x17 gradient:red-blue)
# ImageMagick writes bottom-up bitmaps; BMP2 is the old format with the 12-byte core header.
picture(bottom-up.bmp -size 800x600 gradient:red-blue)
picture(BMP2:core-header.bmp -size 120x90 gradient:red-blue)
# JPEG with an EXIF segment (APP1) before the frame header, baseline (C0) and progressive (C2).
picture(baseline-exif.jpg -size 640x480 gradient:red-blue -profile "APP1:${SOURCE}/data/orientation.exif")
picture(progressive-exif.jpg -size 200x300 gradient:red-blue -profile "APP1:${SOURCE}/data/orientation.exif"
        -interlace Plane)
# A comment segment longer than 32767 bytes before the frame header.
string(REPEAT "0123456789" 4000 longComment)
file(WRITE "${OUT}/long-comment.txt" "${longComment}")
picture(long-comment.jpg -size 240x90 gradient:red-blue -comment "@${OUT}/long-comment.txt")
# Wide pictures, beyond 16-bit signed sides.
picture(wide.png -size 40000x8 xc:white)
picture(wide.gif -size 40000x8 xc:white +dither -colors 2)
picture(wide.bmp -size 40000x8 xc:white)
picture(wide.jpg -size 40000x8 xc:white)
picture(tall.png -size 8x70000 xc:white)
