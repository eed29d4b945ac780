-- commonTerms_kor: Korean texts of the keys in structured error
-- descriptions. Exactly the keys of commonTerms_eng, in its sections and
-- order; a key this table lacked would read English. Texts are UTF-8 and use
-- only characters of code page 949.
--
-- Sections:
--   1. Usage types: the key shown before ": " and the value
--   2. DriverSetup and session-information messages (elaborations)
--   3. Other elaboration texts (the key is the English text)
--   4. Debug item keys

local entries = {
  -- 1. Usage types -------------------------------------------------------------
  kUsageTypeAffectedAttribute = "영향을 받는 속성",
  kUsageTypeAttributeId = "속성",
  kUsageTypeAttributeIdentifier = "속성 식별자",
  kUsageTypeConflictingAttr = "충돌하는 속성",
  kUsageTypeConflictingProperty = "충돌하는 프로퍼티",
  kUsageTypeDevice = "장치",
  kUsageTypeFilePath = "파일 경로",
  kUsageTypeInvalidIdentifier = "잘못된 식별자",
  kUsageTypeParameterName = "매개변수 이름",
  kUsageTypeRequestedDeviceName = "요청한 장치 이름",
  kUsageTypeRequestedValue = "요청한 값",
  kUsageTypeUnspecifiedProperty = "지정되지 않은 프로퍼티",
  kSidlUsageTypeErrno = "시스템 호출이 반환한 errno 값",

  -- 2. DriverSetup and session-information messages ---------------------------
  kSidlSetupContainsEqual = "DriverSetup 문자열에는 '='를 사용할 수 없습니다.",
  kSidlSetupNotParsed = "DriverSetup 문자열을 구문 분석할 수 없습니다. 문자열 형식은 설명서를 참조하십시오.",
  kSidlInvalidTag = "잘못된 DriverSetup 태그입니다.",
  kSidlRepeatedTag = "DriverSetup 태그가 중복되었습니다.",
  kSidlNotInteger = "DriverSetup 값이 정수가 아닙니다.",
  kSidlNotBoolean = "DriverSetup 값이 부울 값이 아닙니다. 0 또는 1을 사용하십시오.",
  kSidlNoTag = "DriverSetup 태그가 지정되지 않았습니다. DriverSetup 문자열을 확인하십시오.",
  kSidlNoValue = "DriverSetup에 값이 없는 항목이 있습니다.",
  kSidlInvalidLanguage = "DriverSetup에 지정된 언어가 잘못되었습니다.",
  kSidlInvalidResourceName = "잘못된 리소스 이름입니다.",
  kSidlRepeatedResourceName = "DriverSetup 문자열에 리소스 이름이 중복되어 있습니다. DriverSetup에는 각 리소스 " ..
    "이름을 한 번만 지정하십시오.",
  kSidlNoResourceName = "옵션 문자열의 DriverSetup 태그에 ResourceName 필드가 없습니다. 허용되는 문자열 " ..
    "형식은 옵션 문자열 설명서를 참조하십시오.",
  kSidlInvalidFileHandle = "잘못된 파일 핸들입니다.",
  kSidlInitialization = "세션 정보를 초기화할 수 없었습니다.",
  kSidlMaxNumSessionsExceeded = "최대 세션 수를 초과했습니다.",
  kSidlSharedMemMutex = "공유 세션 정보의 잠금을 얻을 수 없었습니다.",

  -- 3. Other elaboration texts --------------------------------------------------
  ["Oversized session information table data section"] = "세션 정보 테이블의 데이터 섹션이 너무 큽니다",
  ["You must set the CloseFunctionPtr prior to calling any functions."] =
    "함수를 호출하기 전에 CloseFunctionPtr을 설정해야 합니다.",
  ["Windows generated an error"] = "운영 체제에서 오류를 보고했습니다",
  ["Windows Error Code:"] = "시스템 오류 코드",
  ["Windows Error Message:"] = "시스템 오류 메시지",

  -- 4. Debug item keys ----------------------------------------------------------
  Component = "구성 요소",
  File = "파일",
  Line = "줄",
  ["Internal Error"] = "내부 오류",
  -- The parts of a description the translator did not use, shown as JSON;
  -- the key is a name and stays the same in every language.
  rest_of_input_json = "rest_of_input_json",
}

return require("cvmxl_utilities").stringTable(entries)
