# Points JAVA_HOME at the JDK of the javac on the path, where nobody has set it: CMake's own search
# misses some Debian folder names.
if(NOT ANDROID AND NOT DEFINED ENV{JAVA_HOME})
  find_program(DRAVENTA_JAVAC javac)
  if(DRAVENTA_JAVAC)
    file(REAL_PATH ${DRAVENTA_JAVAC} javac)
    cmake_path(GET javac PARENT_PATH bin)
    cmake_path(GET bin PARENT_PATH home)
    set(ENV{JAVA_HOME} ${home})
  endif()
endif()
