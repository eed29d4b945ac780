-- commonTerms_jpn: Japanese texts of the keys in structured error
-- descriptions. Exactly the keys of commonTerms_eng, in its sections and
-- order; a key this table lacked would read English. Texts are UTF-8 and use
-- only characters of code page 932.
--
-- Sections:
--   1. Usage types: the key shown before ": " and the value
--   2. DriverSetup and session-information messages (elaborations)
--   3. Other elaboration texts (the key is the English text)
--   4. Debug item keys

local entries = {
  -- 1. Usage types -------------------------------------------------------------
  kUsageTypeAffectedAttribute = "影響を受ける属性",
  kUsageTypeAttributeId = "属性",
  kUsageTypeAttributeIdentifier = "属性の識別子",
  kUsageTypeConflictingAttr = "競合する属性",
  kUsageTypeConflictingProperty = "競合するプロパティ",
  kUsageTypeDevice = "デバイス",
  kUsageTypeFilePath = "ファイルパス",
  kUsageTypeInvalidIdentifier = "無効な識別子",
  kUsageTypeParameterName = "パラメータ名",
  kUsageTypeRequestedDeviceName = "要求されたデバイス名",
  kUsageTypeRequestedValue = "要求された値",
  kUsageTypeUnspecifiedProperty = "指定されていないプロパティ",
  kSidlUsageTypeErrno = "システムコールが返した errno の値",

  -- 2. DriverSetup and session-information messages ---------------------------
  kSidlSetupContainsEqual = "DriverSetup 文字列に '=' を含めることはできません。",
  kSidlSetupNotParsed = "DriverSetup 文字列を解析できません。文字列の形式については、ドキュメントを参照してください。",
  kSidlInvalidTag = "DriverSetup のタグが無効です。",
  kSidlRepeatedTag = "DriverSetup のタグが重複しています。",
  kSidlNotInteger = "DriverSetup の値が整数ではありません。",
  kSidlNotBoolean = "DriverSetup の値がブール値ではありません。0 または 1 を指定してください。",
  kSidlNoTag = "DriverSetup のタグが指定されていません。DriverSetup 文字列を確認してください。",
  kSidlNoValue = "DriverSetup に値のないエントリがあります。",
  kSidlInvalidLanguage = "DriverSetup で指定された言語が無効です。",
  kSidlInvalidResourceName = "リソース名が無効です。",
  kSidlRepeatedResourceName = "DriverSetup 文字列でリソース名が重複しています。DriverSetup では各リソース名を" ..
    "1 回だけ指定してください。",
  kSidlNoResourceName = "オプション文字列の DriverSetup タグに ResourceName フィールドがありません。" ..
    "使用できる文字列の形式については、オプション文字列のドキュメントを参照してください。",
  kSidlInvalidFileHandle = "ファイルハンドルが無効です。",
  kSidlInitialization = "セッション情報を初期化できませんでした。",
  kSidlMaxNumSessionsExceeded = "セッション数が上限を超えました。",
  kSidlSharedMemMutex = "共有セッション情報のロックを取得できませんでした。",

  -- 3. Other elaboration texts --------------------------------------------------
  ["Oversized session information table data section"] = "セッション情報テーブルのデータセクションが大きすぎます",
  ["You must set the CloseFunctionPtr prior to calling any functions."] =
    "関数を呼び出す前に CloseFunctionPtr を設定する必要があります。",
  ["Windows generated an error"] = "オペレーティングシステムがエラーを報告しました",
  ["Windows Error Code:"] = "システムエラーコード",
  ["Windows Error Message:"] = "システムエラーメッセージ",

  -- 4. Debug item keys ----------------------------------------------------------
  Component = "コンポーネント",
  File = "ファイル",
  Line = "行",
  ["Internal Error"] = "内部エラー",
  -- The parts of a description the translator did not use, shown as JSON;
  -- the key is a name and stays the same in every language.
  rest_of_input_json = "rest_of_input_json",
}

return require("cvmxl_utilities").stringTable(entries)
