-- errors_deu: German static descriptions of status codes.
--
-- Exactly the keys of errors_eng, in the same sections and order, so that
-- the two files can be compared line by line. Keys are status codes as the
-- driver reports them (0xBFFA... literals) or, for infrastructure codes,
-- their original value before mapping (-52000 ...).
--
-- Terminology used throughout: session = "Sitzung", attribute = "Attribut",
-- channel = "Kanal", acquisition = "Erfassung", record = "Datensatz",
-- trigger = "Trigger", driver = "Treiber", server = "Server", pipe = "Pipe",
-- time-out = "Zeitlimit", instrument = "Messgerät", option string =
-- "Optionsstring", handle = "Handle", IVI engine = "IVI-Engine".
--
-- Sections, in order:
--   1. IVI engine status codes that this system raises
--   2. Remoting layer: sessions, reservation and privileges
--   3. Remoting layer: transport and protocol
--   4. Infrastructure codes (mapped into 0xBFFA9400 to 0xBFFA9500)
--   5. Host-environment and system codes
--   6. The stand-in IVI engine's own codes
--   7. The simulated digitizer driver's own codes

local entries = {
  -- 1. IVI engine status codes that this system raises ----------------------
  [0xBFFA0000] = "Nicht behebbarer Fehler. Die Bibliothek der IVI-Engine konnte nicht geladen werden, oder " ..
    "in ihr ist ein Fehler aufgetreten, von dem sich der Treiber nicht erholen kann.",
  [0xBFFA0009] = "Eine für diesen Vorgang benötigte Funktion fehlt in der Bibliothek der IVI-Engine oder " ..
    "in der Treiberbibliothek.",
  [0xBFFA000F] = "Ungültiger Parameter. Ein Parameter der Funktion hat einen unzulässigen Wert, zum " ..
    "Beispiel eine negative Puffergröße oder einen fehlenden Ausgabezeiger.",
  [0xBFFA0010] = "Ungültiger Wert. Ein Parameter oder Attribut hat einen Wert außerhalb des zulässigen " ..
    "Bereichs, zum Beispiel eine angeforderte Anzahl von Abtastwerten oder Punkten oder eine " ..
    "Datensatzlänge, die die angeforderte Anzahl von Abtastwerten übersteigt.",
  [0xBFFA0013] = "Der Wert wird nicht unterstützt. Der angeforderte Datentyp oder die angeforderte Größe " ..
    "kann von diesem Vorgang nicht verarbeitet werden.",
  [0xBFFA004A] = "Der Optionsstring enthält einen unbekannten Optionsnamen, oder eine Option konnte nicht " ..
    "geändert werden. Prüfen Sie die Syntax des Optionsstrings und seines DriverSetup-Eintrags.",
  [0xBFFA004C] = "Der Optionsstring oder sein DriverSetup-Eintrag enthält einen ungültigen Wert.",
  [0xBFFA0056] = "Dem System steht nicht genügend Speicher zur Verfügung, oder es konnte keine " ..
    "gemeinsam genutzte Ressource anlegen.",
  [0xBFFA0058] = "Ein erforderlicher Zeigerparameter ist NULL.",
  [0xBFFA0060] = "Der Ressourcenname oder logische Name ist in der Systemkonfiguration nicht bekannt.",

  -- 2. Remoting layer: sessions, reservation and privileges -----------------
  [0xBFFA1190] = "Das Sitzungs-Handle ist ungültig. Die Sitzung wurde nie geöffnet oder ist bereits " ..
    "geschlossen.",
  [0xBFFA402B] = "Die Signalverlaufsanforderung liefert mehr als einen Datensatz, bei diesem Aufruf ist " ..
    "jedoch nur ein einziger Datensatz zulässig.",
  [0xBFFA402E] = "Die Ressource ist von einem anderen Prozess reserviert, oder die Sitzung hat nicht die " ..
    "Berechtigung, die dieser Vorgang erfordert.",
  [0xBFFA40BA] = "Der Abruf-, Lese- oder Abfragevorgang ist in dem Prozess fehlgeschlagen, dem das " ..
    "Messgerät gehört.",
  [0xBFFA8BF0] = "Die Einstellungen der Debug-Sitzung der Geräte stimmen nicht überein. Alle gemeinsam " ..
    "verwendeten Geräte müssen dieselben Einstellungen der Debug-Sitzung haben.",
  [0xBFFA8CF0] = "Der DriverSetup-Eintrag des Optionsstrings gibt seine Ressourcen nicht korrekt an.",
  [0xBFFA9175] = "Der Ressourcenname ist mehrdeutig: Er trifft auf mehrere Geräte zu.",
  [0xBFFA9178] = "Für diese Ressource besteht bereits ein Server für eine andere Treibersitzung.",
  [0xBFFA9181] = "Die Sitzung hat für diesen Vorgang keine ausreichende Berechtigung. Eine andere Sitzung " ..
    "steuert das Messgerät.",
  [0xBFFA9182] = "Der Vorgang ist in dem Prozess fehlgeschlagen, dem das Messgerät gehört.",

  -- 3. Remoting layer: transport and protocol --------------------------------
  [0xBFFA914E] = "Der Fernaufruf ist fehlgeschlagen: Der Server hat mit einem Anwendungsfehler " ..
    "geantwortet, zum Beispiel mit einem fehlenden Ergebnis oder einer Antwort in falscher Reihenfolge.",
  [0xBFFA914F] = "Der Fernaufruf ist fehlgeschlagen: Die Nachricht konnte nicht codiert oder decodiert " ..
    "werden.",
  [0xBFFA9150] = "Der Fernaufruf ist fehlgeschlagen: Die Nachricht enthält ungültige Daten.",
  [0xBFFA9151] = "Der Fernaufruf ist fehlgeschlagen: Die Nachricht enthält eine negative Größe.",
  [0xBFFA9152] = "Der Fernaufruf ist fehlgeschlagen: Die Nachricht überschreitet eine Größenbeschränkung.",
  [0xBFFA9153] = "Der Fernaufruf ist fehlgeschlagen: Die Protokollversion der Nachricht wird nicht " ..
    "unterstützt.",
  [0xBFFA9154] = "Der Fernaufruf ist fehlgeschlagen: Die Nachricht verwendet eine Protokollfunktion, die " ..
    "nicht implementiert ist.",
  [0xBFFA9155] = "Der Fernaufruf ist fehlgeschlagen: Die Verbindung zum Server hat einen Fehler gemeldet.",
  [0xBFFA9156] = "Die Verbindung zum Server konnte nicht hergestellt werden. Stellen Sie sicher, dass der " ..
    "Prozess läuft, dem das Messgerät gehört.",
  [0xBFFA9157] = "Bei der Verbindung zum Server wurde das Zeitlimit überschritten.",
  [0xBFFA9158] = "Die Verbindung zum Server wurde unerwartet geschlossen.",
  [0xBFFA9159] = "Die Verbindung zum Server wurde unterbrochen.",
  [0xBFFA915A] = "Die Verbindung zum Server wurde mit ungültigen Argumenten verwendet.",
  [0xBFFA915B] = "Die vom Server empfangenen Daten sind beschädigt.",
  [0xBFFA915C] = "Die Verbindung zum Server ist wegen eines internen Fehlers fehlgeschlagen.",

  -- 4. Infrastructure codes (original values; reported as 0xBFFA9400 + n) ----
  [-52000] = "Zum Abschließen des Vorgangs steht nicht genügend Speicher zur Verfügung.",
  [-52003] = "Ein interner Fehler ist aufgetreten.",
  [-52005] = "An eine interne Funktion wurde ein ungültiges Handle oder Argument übergeben.",
  [-52006] = "Das Datei-Handle ist ungültig, oder die Datei konnte nicht geöffnet werden.",
  [-52008] = "Ein Systemaufruf ist fehlgeschlagen.",
  [-52027] = "Der Text konnte nicht zwischen Zeichencodierungen umgewandelt werden.",
  [-52029] = "Die Fehlerbeschreibung hat ein Format, das nicht unterstützt wird.",

  -- 5. Host-environment and system codes -------------------------------------
  [0xBFFF0000] = "Ein unerwarteter Systemfehler ist aufgetreten.",
  [0xBFFF0011] = "Das Gerät wurde nicht gefunden, oder es wird von diesem Treiber nicht unterstützt.",
  [0xBFFF003C] = "Zum Ändern der Größe des Arrays steht nicht genügend Speicher zur Verfügung.",
  [0xBFFF0078] = "Die Größe des Arrays konnte nicht geändert werden: Die Speicherverwaltung der " ..
    "Host-Umgebung hat die Anforderung abgelehnt.",

  -- 6. The stand-in IVI engine's own codes -------------------------------------
  -- Codes the engine shares with section 1 (0xBFFA0000, 0xBFFA0009, 0xBFFA000F,
  -- 0xBFFA0010, 0xBFFA0013, 0xBFFA004A, 0xBFFA004C, 0xBFFA0058) and section 2
  -- (0xBFFA1190) keep their text there. The engine defines no warnings.
  [0xBFFA0002] = "Eine Datei konnte nicht geöffnet werden, zum Beispiel weil sie nicht existiert oder " ..
    "dieser Prozess sie nicht lesen darf.",
  [0xBFFA0003] = "Beim Lesen einer Datei ist ein Fehler aufgetreten.",
  [0xBFFA000C] = "Die Attribut-ID ist der Sitzung der IVI-Engine nicht bekannt.",
  [0xBFFA000D] = "Das Attribut ist schreibgeschützt und kann nicht gesetzt werden.",
  [0xBFFA000E] = "Das Attribut kann nur geschrieben und nicht gelesen werden.",
  [0xBFFA0011] = "Die Funktion wird von der IVI-Engine nicht unterstützt.",
  [0xBFFA0012] = "Das Attribut wird von dieser Sitzung nicht unterstützt.",
  [0xBFFA0014] = "Der Typ ist kein gültiger Attributtyp.",
  [0xBFFA0015] = "Das Attribut und die Funktion, die es liest oder schreibt, haben nicht denselben " ..
    "Datentyp.",
  [0xBFFA0017] = "Das Element ist bereits vorhanden, zum Beispiel ein zweimal hinzugefügtes Attribut " ..
    "oder ein zweimal hinzugefügter Kanalname.",
  [0xBFFA0018] = "Die Konfigurationsdatei der logischen Namen enthält eine ungültige Zeile.",
  [0xBFFA001B] = "Das Attribut hat keine Bereichstabelle.",
  [0xBFFA001C] = "Die Bereichstabelle ist ungültig.",
  [0xBFFA001F] = "Die Sitzung hat keine Kanaltabelle.",
  [0xBFFA0020] = "Der Kanalname oder der Name der wiederholten Fähigkeit ist der Sitzung nicht bekannt.",
  [0xBFFA0021] = "Eine Systemressource konnte nicht zugewiesen werden.",
  [0xBFFA0030] = "Der aufrufende Thread hält die Sperre der Sitzung nicht.",
  [0xBFFA0031] = "Das Attribut erfordert einen Kanalnamen oder den Namen einer wiederholten Fähigkeit.",
  [0xBFFA0032] = "Das Attribut akzeptiert weder einen Kanalnamen noch den Namen einer wiederholten " ..
    "Fähigkeit.",
  -- Parameter position errors: parameter 1 to 8 of the function has an invalid value.
  [0xBFFC0001] = "Parameter 1 der Funktion hat einen ungültigen Wert.",
  [0xBFFC0002] = "Parameter 2 der Funktion hat einen ungültigen Wert.",
  [0xBFFC0003] = "Parameter 3 der Funktion hat einen ungültigen Wert.",
  [0xBFFC0004] = "Parameter 4 der Funktion hat einen ungültigen Wert.",
  [0xBFFC0005] = "Parameter 5 der Funktion hat einen ungültigen Wert.",
  [0xBFFC0006] = "Parameter 6 der Funktion hat einen ungültigen Wert.",
  [0xBFFC0007] = "Parameter 7 der Funktion hat einen ungültigen Wert.",
  [0xBFFC0008] = "Parameter 8 der Funktion hat einen ungültigen Wert.",

  -- 7. The simulated digitizer driver's own codes ------------------------------
  -- Errors 0xBFFA5000 to 0xBFFA5014, then warnings from 0x3FFA5000.
  [0xBFFA5000] = "Das Sitzungs-Handle bezeichnet keine geöffnete Sitzung des Digitalisierer-Treibers.",
  [0xBFFA5001] = "Der Kanalname oder die Kanalliste ist für dieses Messgerät ungültig.",
  [0xBFFA5002] = "Die Attribut-ID gehört zu keinem Attribut des Digitalisierer-Treibers, oder das " ..
    "Messgerät unterstützt das Attribut nicht.",
  [0xBFFA5003] = "Das Attribut hat einen anderen Datentyp als die Funktion, die es liest oder schreibt.",
  [0xBFFA5004] = "Ein Wert liegt außerhalb des Bereichs, den das Messgerät akzeptiert.",
  [0xBFFA5005] = "Ein erforderliches Zeigerargument ist ein Nullzeiger.",
  [0xBFFA5006] = "Der Puffer ist zu klein für die Daten.",
  [0xBFFA5007] = "Die Erfassung wurde nicht innerhalb des Zeitlimits abgeschlossen, oder sie kann nicht " ..
    "abgeschlossen werden, solange der Abruf auf sie wartet.",
  [0xBFFA5008] = "Es wurde keine Erfassung gestartet oder abgeschlossen, daher sind keine Daten vorhanden.",
  [0xBFFA5009] = "Das Attribut kann nicht geschrieben werden, weil es schreibgeschützt ist, oder nicht " ..
    "gelesen werden, weil es nur geschrieben werden kann.",
  [0xBFFA500A] = "Die gespeicherte Attributkonfiguration ist beschädigt, unvollständig oder für ein " ..
    "anderes Modell bestimmt.",
  [0xBFFA500B] = "Die Datei kann nicht geöffnet, gelesen oder geschrieben werden.",
  [0xBFFA500C] = "Der Registeroffset oder die Registergröße ist ungültig, oder das Register ist " ..
    "schreibgeschützt.",
  [0xBFFA500D] = "Die Datensätze der Erfassung benötigen mehr Abtastwerte pro Kanal, als der " ..
    "Erfassungsspeicher des Messgeräts aufnehmen kann.",
  [0xBFFA500E] = "Die Triggerquelle oder der Triggeranschluss ist für diese Triggerart oder für dieses " ..
    "Messgerät ungültig.",
  [0xBFFA500F] = "Kanalliste und Anzahl der Datensätze ergeben nicht die Anzahl von Signalverläufen, die " ..
    "der Vorgang benötigt, zum Beispiel genau einen für eine skalare Messung.",
  [0xBFFA5010] = "Die Messung kann an diesem Signalverlauf nicht durchgeführt werden.",
  [0xBFFA5011] = "Der DriverSetup-Eintrag des Optionsstrings nennt ein Modell, das dem Treiber nicht " ..
    "bekannt ist.",
  [0xBFFA5012] = "Die Funktion, das Abtastwertformat oder der Modus wird nicht unterstützt.",
  [0xBFFA5013] = "Der Optionsstring ist ungültig: Er enthält einen unbekannten Optionsnamen oder einen " ..
    "ungültigen Wert.",
  [0xBFFA5014] = "Dem Treiber stehen nicht genügend Speicher oder Systemressourcen zur Verfügung, oder " ..
    "es ist ein interner Fehler aufgetreten.",
  [0x3FFA5000] = "Einige Abtastwerte haben eine Grenze des vertikalen Bereichs erreicht und wurden " ..
    "abgeschnitten.",
}

return require("cvmxl_utilities").stringTable(entries)
