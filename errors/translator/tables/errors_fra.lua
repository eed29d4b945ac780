-- errors_fra: French static descriptions of status codes.
--
-- Exactly the keys of errors_eng, in the same sections and order, so that
-- the two files can be compared line by line. Keys are status codes as the
-- driver reports them (0xBFFA... literals) or, for infrastructure codes,
-- their original value before mapping (-52000 ...).
--
-- Terminology used throughout: session = "session", attribute = "attribut",
-- channel = "voie", acquisition = "acquisition", record = "enregistrement",
-- trigger = "déclenchement", driver = "pilote", server = "serveur",
-- pipe = "tube", time-out = "délai d'attente", instrument = "instrument",
-- option string = "chaîne d'options", IVI engine = "moteur IVI".
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
  [0xBFFA0000] = "Défaillance irrécupérable. La bibliothèque du moteur IVI n'a pas pu être chargée, ou elle " ..
    "a subi une défaillance dont le pilote ne peut pas se rétablir.",
  [0xBFFA0009] = "Une fonction nécessaire à cette opération est absente de la bibliothèque du moteur IVI " ..
    "ou de celle du pilote.",
  [0xBFFA000F] = "Paramètre non valide. Un paramètre de la fonction a une valeur non autorisée, par " ..
    "exemple une taille de tampon négative ou un pointeur de sortie manquant.",
  [0xBFFA0010] = "Valeur non valide. Un paramètre ou un attribut a une valeur hors limites, par exemple " ..
    "un nombre d'échantillons ou de points demandé, ou un enregistrement plus long que le nombre " ..
    "d'échantillons demandé.",
  [0xBFFA0013] = "Valeur non prise en charge. Cette opération ne peut pas traiter le type ou la taille " ..
    "de données demandés.",
  [0xBFFA004A] = "La chaîne d'options contient un nom d'option inconnu, ou une option n'a pas pu être " ..
    "modifiée. Vérifiez la syntaxe de la chaîne d'options et de son entrée DriverSetup.",
  [0xBFFA004C] = "La chaîne d'options ou son entrée DriverSetup contient une valeur non valide.",
  [0xBFFA0056] = "Le système ne dispose plus de mémoire suffisante ou n'a pas pu créer une ressource " ..
    "partagée.",
  [0xBFFA0058] = "Un paramètre de type pointeur obligatoire vaut NULL.",
  [0xBFFA0060] = "Le nom de ressource ou le nom logique est inconnu de la configuration du système.",

  -- 2. Remoting layer: sessions, reservation and privileges -----------------
  [0xBFFA1190] = "Le descripteur de session n'est pas valide. La session n'a jamais été ouverte ou a " ..
    "déjà été fermée.",
  [0xBFFA402B] = "La demande de forme d'onde renvoie plusieurs enregistrements, alors que cet appel " ..
    "n'en autorise qu'un seul.",
  [0xBFFA402E] = "La ressource est réservée par un autre processus, ou la session ne dispose pas du " ..
    "privilège nécessaire à cette opération.",
  [0xBFFA40BA] = "L'opération de récupération, de lecture ou d'interrogation a échoué dans le processus " ..
    "propriétaire de l'instrument.",
  [0xBFFA8BF0] = "Les paramètres de session de débogage des périphériques ne sont pas identiques. Tous " ..
    "les périphériques utilisés ensemble doivent avoir les mêmes paramètres de session de débogage.",
  [0xBFFA8CF0] = "L'entrée DriverSetup de la chaîne d'options ne désigne pas correctement ses ressources.",
  [0xBFFA9175] = "Le nom de ressource est ambigu : plusieurs périphériques y correspondent.",
  [0xBFFA9178] = "Un serveur existe déjà pour cette ressource ; il appartient à une autre session de pilote.",
  [0xBFFA9181] = "La session ne dispose pas d'un privilège suffisant pour cette opération. Une autre " ..
    "session contrôle l'instrument.",
  [0xBFFA9182] = "L'opération a échoué dans le processus propriétaire de l'instrument.",

  -- 3. Remoting layer: transport and protocol --------------------------------
  [0xBFFA914E] = "L'appel distant a échoué : le serveur a répondu par une erreur d'application, par " ..
    "exemple un résultat manquant ou une réponse hors séquence.",
  [0xBFFA914F] = "L'appel distant a échoué : le message n'a pas pu être codé ou décodé.",
  [0xBFFA9150] = "L'appel distant a échoué : le message contient des données non valides.",
  [0xBFFA9151] = "L'appel distant a échoué : le message contient une taille négative.",
  [0xBFFA9152] = "L'appel distant a échoué : le message dépasse une limite de taille.",
  [0xBFFA9153] = "L'appel distant a échoué : la version de protocole du message n'est pas prise en charge.",
  [0xBFFA9154] = "L'appel distant a échoué : le message utilise une fonctionnalité du protocole qui n'est " ..
    "pas implémentée.",
  [0xBFFA9155] = "L'appel distant a échoué : la connexion au serveur a signalé une erreur.",
  [0xBFFA9156] = "La connexion au serveur n'a pas pu être ouverte. Vérifiez que le processus propriétaire " ..
    "de l'instrument est en cours d'exécution.",
  [0xBFFA9157] = "Le délai d'attente de la connexion au serveur a expiré.",
  [0xBFFA9158] = "La connexion au serveur a été fermée de manière inattendue.",
  [0xBFFA9159] = "La connexion au serveur a été interrompue.",
  [0xBFFA915A] = "La connexion au serveur a été utilisée avec des arguments non valides.",
  [0xBFFA915B] = "Les données reçues du serveur sont corrompues.",
  [0xBFFA915C] = "La connexion au serveur a échoué en raison d'une erreur interne.",

  -- 4. Infrastructure codes (original values; reported as 0xBFFA9400 + n) ----
  [-52000] = "La mémoire disponible est insuffisante pour terminer l'opération.",
  [-52003] = "Une erreur interne s'est produite.",
  [-52005] = "Un descripteur ou un argument non valide a été transmis à une fonction interne.",
  [-52006] = "Le descripteur de fichier n'est pas valide ou le fichier n'a pas pu être ouvert.",
  [-52008] = "Un appel système a échoué.",
  [-52027] = "Le texte n'a pas pu être converti d'un codage de caractères à un autre.",
  [-52029] = "La description de l'erreur est dans un format non pris en charge.",

  -- 5. Host-environment and system codes -------------------------------------
  [0xBFFF0000] = "Une erreur système inattendue s'est produite.",
  [0xBFFF0011] = "Le périphérique est introuvable, ou ce n'est pas un périphérique pris en charge par " ..
    "ce pilote.",
  [0xBFFF003C] = "La mémoire disponible est insuffisante pour redimensionner le tableau.",
  [0xBFFF0078] = "Le tableau n'a pas pu être redimensionné : le gestionnaire de mémoire de " ..
    "l'environnement hôte a refusé la demande.",

  -- 6. The stand-in IVI engine's own codes -------------------------------------
  -- Codes the engine shares with section 1 (0xBFFA0000, 0xBFFA0009, 0xBFFA000F,
  -- 0xBFFA0010, 0xBFFA0013, 0xBFFA004A, 0xBFFA004C, 0xBFFA0058) and section 2
  -- (0xBFFA1190) keep their text there. The engine defines no warnings.
  [0xBFFA0002] = "Un fichier n'a pas pu être ouvert, par exemple parce qu'il n'existe pas ou que ce " ..
    "processus n'est pas autorisé à le lire.",
  [0xBFFA0003] = "Une erreur s'est produite lors de la lecture d'un fichier.",
  [0xBFFA000C] = "L'identificateur d'attribut n'est pas reconnu par la session du moteur IVI.",
  [0xBFFA000D] = "L'attribut est en lecture seule et ne peut pas être défini.",
  [0xBFFA000E] = "L'attribut est en écriture seule et ne peut pas être lu.",
  [0xBFFA0011] = "La fonction n'est pas prise en charge par le moteur IVI.",
  [0xBFFA0012] = "L'attribut n'est pas pris en charge par cette session.",
  [0xBFFA0014] = "Ce type n'est pas un type d'attribut valide.",
  [0xBFFA0015] = "L'attribut et la fonction qui le lit ou l'écrit n'ont pas le même type de données.",
  [0xBFFA0017] = "L'élément existe déjà, par exemple un attribut ou un nom de voie ajouté deux fois.",
  [0xBFFA0018] = "Le fichier de configuration des noms logiques contient une ligne non valide.",
  [0xBFFA001B] = "L'attribut n'a pas de table de plages.",
  [0xBFFA001C] = "La table de plages n'est pas valide.",
  [0xBFFA001F] = "La session n'a pas de table des voies.",
  [0xBFFA0020] = "Le nom de voie ou le nom de capacité répétée est inconnu de la session.",
  [0xBFFA0021] = "Une ressource système n'a pas pu être allouée.",
  [0xBFFA0030] = "Le thread appelant ne détient pas le verrou de la session.",
  [0xBFFA0031] = "L'attribut exige un nom de voie ou un nom de capacité répétée.",
  [0xBFFA0032] = "L'attribut n'accepte pas de nom de voie ni de nom de capacité répétée.",
  -- Parameter position errors: parameter 1 to 8 of the function has an invalid value.
  [0xBFFC0001] = "Le paramètre 1 de la fonction a une valeur non valide.",
  [0xBFFC0002] = "Le paramètre 2 de la fonction a une valeur non valide.",
  [0xBFFC0003] = "Le paramètre 3 de la fonction a une valeur non valide.",
  [0xBFFC0004] = "Le paramètre 4 de la fonction a une valeur non valide.",
  [0xBFFC0005] = "Le paramètre 5 de la fonction a une valeur non valide.",
  [0xBFFC0006] = "Le paramètre 6 de la fonction a une valeur non valide.",
  [0xBFFC0007] = "Le paramètre 7 de la fonction a une valeur non valide.",
  [0xBFFC0008] = "Le paramètre 8 de la fonction a une valeur non valide.",

  -- 7. The simulated digitizer driver's own codes ------------------------------
  -- Errors 0xBFFA5000 to 0xBFFA5014, then warnings from 0x3FFA5000.
  [0xBFFA5000] = "Le descripteur de session ne désigne aucune session ouverte du pilote du numériseur.",
  [0xBFFA5001] = "Le nom de voie ou la liste de voies n'est pas valide pour cet instrument.",
  [0xBFFA5002] = "L'identificateur d'attribut ne correspond à aucun attribut du pilote du numériseur, " ..
    "ou l'instrument ne prend pas cet attribut en charge.",
  [0xBFFA5003] = "Le type de données de l'attribut diffère de celui de la fonction qui le lit ou l'écrit.",
  [0xBFFA5004] = "Une valeur se trouve en dehors de la plage acceptée par l'instrument.",
  [0xBFFA5005] = "Un argument de type pointeur obligatoire est un pointeur NULL.",
  [0xBFFA5006] = "Le tampon est trop petit pour contenir les données.",
  [0xBFFA5007] = "L'acquisition ne s'est pas terminée avant l'expiration du délai d'attente, ou elle ne " ..
    "peut pas se terminer tant que la récupération des données l'attend.",
  [0xBFFA5008] = "Aucune acquisition n'a été lancée ni terminée : il n'y a donc aucune donnée à renvoyer.",
  [0xBFFA5009] = "L'attribut ne peut pas être écrit, car il est en lecture seule, ou ne peut pas être lu, " ..
    "car il est en écriture seule.",
  [0xBFFA500A] = "La configuration d'attributs enregistrée est endommagée, incomplète ou destinée à un " ..
    "autre modèle.",
  [0xBFFA500B] = "Le fichier ne peut pas être ouvert, lu ou écrit.",
  [0xBFFA500C] = "Le décalage ou la taille du registre n'est pas valide, ou le registre est en lecture seule.",
  [0xBFFA500D] = "Les enregistrements de l'acquisition exigent plus d'échantillons par voie que la " ..
    "mémoire d'acquisition de l'instrument ne peut en contenir.",
  [0xBFFA500E] = "La source ou la borne de déclenchement n'est pas valide pour ce type de déclenchement " ..
    "ou pour cet instrument.",
  [0xBFFA500F] = "La liste de voies et le nombre d'enregistrements ne donnent pas le nombre de formes " ..
    "d'onde requis par l'opération, par exemple exactement une pour une mesure scalaire.",
  [0xBFFA5010] = "La mesure ne peut pas être effectuée sur cette forme d'onde.",
  [0xBFFA5011] = "L'entrée DriverSetup de la chaîne d'options désigne un modèle inconnu du pilote.",
  [0xBFFA5012] = "La fonction, le format d'échantillon ou le mode n'est pas pris en charge.",
  [0xBFFA5013] = "La chaîne d'options n'est pas valide : elle contient un nom d'option inconnu ou une " ..
    "valeur non valide.",
  [0xBFFA5014] = "Le pilote ne dispose plus de mémoire ou de ressources système suffisantes, ou a " ..
    "rencontré une défaillance interne.",
  [0x3FFA5000] = "Certains échantillons ont atteint une limite de la plage verticale et ont été écrêtés.",
}

return require("cvmxl_utilities").stringTable(entries)
