# The fuzz targets: one entry point per parser, its source under targets/
# and the libraries it exercises. Read by the fuzzer build here and by the
# corpus replay tests, so both always cover the same list.
set(HF_FUZZ_DIR ${CMAKE_CURRENT_LIST_DIR})
set(HF_FUZZ_TARGETS
  is_this_eps eps_wrapper server_description folder_config
  preferences_file hotfolder_list client_config preference_node folder_journal shown_text)

# `cmake -DHF_PRINT_FUZZ_TARGETS=ON -P FuzzTargets.cmake` prints the list for
# scripts/fuzz.sh.
if(HF_PRINT_FUZZ_TARGETS)
  string(REPLACE ";" " " names "${HF_FUZZ_TARGETS}")
  message("${names}")
  return()
endif()

# The engine's targets run without the toolkit; every other one also takes
# the toolkit half of the support code.
set(HF_FUZZ_ENGINE_TARGETS is_this_eps eps_wrapper shown_text)
foreach(name ${HF_FUZZ_TARGETS})
  if(name IN_LIST HF_FUZZ_ENGINE_TARGETS)
    set(HF_FUZZ_${name}_SUPPORT ${HF_FUZZ_DIR}/support/FuzzSupport.cpp)
  else()
    set(HF_FUZZ_${name}_SUPPORT
      ${HF_FUZZ_DIR}/support/FuzzSupport.cpp ${HF_FUZZ_DIR}/support/FuzzToolkit.cpp)
  endif()
endforeach()

set(HF_FUZZ_is_this_eps_SOURCE IsThisEpsFuzzer.cpp)
set(HF_FUZZ_is_this_eps_LIBS hf_epsconvert)
set(HF_FUZZ_eps_wrapper_SOURCE EpsWrapperFuzzer.cpp)
set(HF_FUZZ_eps_wrapper_LIBS hf_epsconvert)
set(HF_FUZZ_server_description_SOURCE ServerDescriptionFuzzer.cpp)
set(HF_FUZZ_server_description_LIBS hf_db)
set(HF_FUZZ_folder_config_SOURCE FolderConfigFuzzer.cpp)
set(HF_FUZZ_folder_config_LIBS hf_db)
set(HF_FUZZ_preferences_file_SOURCE PreferencesFileFuzzer.cpp)
set(HF_FUZZ_preferences_file_LIBS hf_db)
set(HF_FUZZ_hotfolder_list_SOURCE HotFolderListFuzzer.cpp)
set(HF_FUZZ_hotfolder_list_LIBS hf_db)
set(HF_FUZZ_client_config_SOURCE ClientConfigFuzzer.cpp)
set(HF_FUZZ_client_config_LIBS hf_utils)
set(HF_FUZZ_preference_node_SOURCE PreferenceNodeFuzzer.cpp)
set(HF_FUZZ_preference_node_LIBS hf_plugin)
set(HF_FUZZ_folder_journal_SOURCE FolderJournalFuzzer.cpp)
set(HF_FUZZ_folder_journal_LIBS hf_host_core)
set(HF_FUZZ_shown_text_SOURCE ShownTextFuzzer.cpp)
set(HF_FUZZ_shown_text_LIBS hf_posix)
