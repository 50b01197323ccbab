# Makes the pictures of the PDF tests with ImageMagick. Called as
#   cmake -DCONVERT=<convert> -DSOURCE=<tests/pdf> -DOUT=<folder> -P MakePdfPictures.cmake
file(MAKE_DIRECTORY "${OUT}")
# picture(FORMAT name convert-arguments...): FORMAT is ImageMagick's output format.
function(picture format name)
    execute_process(COMMAND "${CONVERT}" ${ARGN} "${format}:${OUT}/${name}" RESULT_VARIABLE failed)
    if(failed)
        message(FATAL_ERROR "ImageMagick could not make ${name}")
    endif()
endfunction()
# A 4000 x 3000 photograph whose EXIF orientation (6) says: turn it a quarter to the right.
# Stored, its top half is red and its bottom half blue; upright, its left half is blue.
picture(JPEG photo-exif.jpg -size 4000x1500 xc:red -size 4000x1500 xc:blue -append
        -profile "APP1:${SOURCE}/data/orientation-6.exif" -quality 90)
# Transparent at the left, opaque green at the right.
picture(PNG32 transparent.png -size 300x200 xc:none -fill "#00c000" -draw "rectangle 150,0 299,199")
# Not a picture at all.
file(WRITE "${OUT}/broken.jpg" "this is not a JPEG file\n")
