# Sanitizers only work when every object of a program has them, so they are set for the whole tree.
if(CIMDELTA_SANITIZE)
  add_compile_options(-fsanitize=${CIMDELTA_SANITIZE} -fno-omit-frame-pointer -fno-sanitize-recover=all)
  add_link_options(-fsanitize=${CIMDELTA_SANITIZE})
endif()
