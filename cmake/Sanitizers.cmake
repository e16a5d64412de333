# MODRIG_SANITIZE: ON for the address and undefined-behaviour sanitizers, `thread` for the one of threads. The two do not go
# together.
if(MODRIG_SANITIZE STREQUAL thread)
  add_compile_options(-fsanitize=thread -fno-omit-frame-pointer)
  add_link_options(-fsanitize=thread)
elseif(MODRIG_SANITIZE)
  add_compile_options(-fsanitize=address,undefined -fno-sanitize-recover=undefined -fno-omit-frame-pointer)
  add_link_options(-fsanitize=address,undefined)
endif()
