# What the kit is made of, below the folder of the kit or of the sources of Tessel.

# The recording host. What is a pure function of the real host is the same code here, so that there is one rule for it.
set(TESSEL_RECORDING_SOURCES
  host/files/SplitPath.cpp host/messages/Answers.cpp host/text/Format.cpp host/text/Numbers.cpp
  host/text/ResultBuffers.cpp host/text/Unicode.cpp
  tests/support/RecordingHost.cpp
  tests/support/recording/Journal.cpp
  tests/support/recording/RecordingApplicationRecords.cpp
  tests/support/recording/RecordingApplicationServices.cpp
  tests/support/recording/RecordingCommands.cpp
  tests/support/recording/RecordingDocument.cpp
  tests/support/recording/RecordingFiles.cpp
  tests/support/recording/RecordingKeptOut.cpp
  tests/support/recording/RecordingLinker.cpp
  tests/support/recording/RecordingLisp.cpp
  tests/support/recording/RecordingLoadedModules.cpp
  tests/support/recording/RecordingLoans.cpp
  tests/support/recording/RecordingOutput.cpp
  tests/support/recording/RecordingQuestions.cpp
  tests/support/recording/RecordingRegistry.cpp
  tests/support/recording/RecordingRegistryCalls.cpp
  tests/support/recording/RecordingResources.cpp
  tests/support/recording/RecordingResultBuffers.cpp
  tests/support/recording/RecordingServices.cpp
  tests/support/recording/RecordingSession.cpp
  tests/support/recording/RecordingValue.cpp
  tests/support/recording/RecordingVariables.cpp)

# Each program on it has these for itself.
set(TESSEL_RECORDING_PROGRAM_SOURCES
  tests/support/recording/RemovingTsLisp.cpp tests/support/recording/LoanCheck.cpp)

# What every host must do, call by call, written once and run against each host there is.
set(TESSEL_CONTRACT_SOURCES
  tests/contract/ApplicationRecordContractTest.cpp tests/contract/CommandsContractTest.cpp
  tests/contract/FilesContractTest.cpp tests/contract/InternetContractTest.cpp tests/contract/LinkerContractTest.cpp
  tests/contract/LispContractTest.cpp tests/contract/QuestionsContractTest.cpp tests/contract/RegistryContractTest.cpp
  tests/contract/ResourcesContractTest.cpp tests/contract/ResultBufferContractTest.cpp
  tests/contract/ServicesContractTest.cpp tests/contract/SessionContractTest.cpp tests/contract/TextContractTest.cpp)

# Under the names that its callers use stand functions that count what they hand out.
function(tessel_count_result_buffers folder)
  set_source_files_properties("${folder}/host/text/ResultBuffers.cpp" PROPERTIES
    COMPILE_DEFINITIONS "tsutBuildList=realBuildList;tsutRelRb=realReleaseList")
endfunction()
