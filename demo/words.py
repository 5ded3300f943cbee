"""Words, names and sentences from which the demonstration collection is put together.

Everything here is invented. A line of an artist table reads name; genre; first year; last year.
The name's language is that of the table. No text holds "*", which separates fields in the text
formats, and no genre an apostrophe.
"""

ARTISTS = {
    "en": """
Abigail Thorne;Folk;1968;1994
Alder & Ash;Folk;1971;2019
Amber Kincaid;Country;1974;2008
The Ambling Strangers;Rock;1965;1973
Anchor Street;Rock;1981;1996
Bayou Ferguson;Blues;1956;1979
Bell Tower Choirboys;New Wave;1979;1986
Benny Okafor Quartet;Jazz;1958;1972
Blue Tram;Pop;1983;1991
Brackenfield;Folk;1998;2022
Bramwell Pike;Country;1961;1988
Calloway Finch;Singer-songwriter;1999;2023
Cardboard Astronauts;Rock;1992;2011
Carmen Delacourt;Soul;1966;1981
Cinder Lane;Rock;1986;2003
Clockwork Orchards;New Wave;1980;1989
Cordelia Voss;Singer-songwriter;2004;2024
Daisy Merriweather;Pop;1962;1971
Delta Mae Hopper;Blues;1952;1969
Dexter Lamont;Soul;1969;1986
Dial Tone Kids;Punk;1977;1983
The Driftwood Four;Pop;1959;1968
Earl Brasswell;Jazz;1951;1975
Eleven Doors Down;Rock;2001;2018
Elsie Quarterman;Jazz;1954;1976
Emerald Underpass;Electronic;1994;2016
Evergreen Parade;Pop;2008;2024
Fable Street;Rock;1970;1979
Ferris & The Wheelmen;Pop;1963;1969
Flannel Sunday;Rock;1991;1999
Foxglove Avenue;Pop;1985;1995
Frankie Delmonico;Pop;1950;1964
Gasoline Preachers;Rock;1973;1989
Ginger Hollis;Country;1980;2006
Glass Meridian;Electronic;1982;2001
The Grand Arcade;Pop;1966;1974
Gus Pemberton Trio;Jazz;1960;1981
Halfway Lighthouse;Rock;1997;2014
Hazel Winterbourne;Folk;1965;1990
Henry Tolliver;Blues;1950;1968
The Hollow Kites;Rock;2006;2021
Iona Castellan;Folk;1989;2020
Iron Marigold;Metal;1984;2009
Ivory Coastguard;New Wave;1981;1988
Ivy & The Fence;Pop;2011;2024
Jackdaw Parliament;Rock;1969;1978
Jasper Quill;Singer-songwriter;1972;2005
Josephine Ardell;Soul;1964;1979
Jubilee Motors;Rock;1978;1992
Kate Lockridge;Country;1996;2022
Kestrel Bay;Rock;1975;1987
King Barnaby;Reggae;1973;1990
Kit Farraday;Pop;1984;1998
Lantern Hill;Folk;1967;1985
Leroy Washbourne;Soul;1962;1977
Lola Marchetti;Disco;1975;1983
Loose Cables;Electronic;1999;2020
The Lowland Riders;Country;1971;1984
Magnolia Crane;Blues;1988;2015
Marlowe & Sons;Rock;1968;1980
Milton Abernathy Big Band;Jazz;1950;1966
Mister Pelican;Reggae;1977;1995
Mona Fairweather;Pop;1987;2002
Motel Constellation;Rock;1993;2013
Nettle & Thyme;Folk;1974;1996
Newsprint Heroes;Punk;1978;1985
Nora Valentine;Pop;1979;2001
Northbound Platform;Rock;2003;2024
Oakley Dunmore;Country;1957;1975
Octavia Reed;Soul;2002;2023
Ogilvy Square;Pop;1967;1973
Orchid Telegraph;New Wave;1980;1990
Pale Carousel;Rock;1988;2000
Paloma Whitaker;Singer-songwriter;2009;2024
Paper Zeppelins;Pop;1995;2010
Percy Lovelace;Blues;1954;1971
Pilot & The Moths;Rock;1990;2007
Quentin Ashdown;Singer-songwriter;1970;1999
Quicksilver Ladies;Disco;1976;1982
The Quiet Hour;Ambient;1996;2021
Quincy Bellweather;Jazz;1955;1974
Rainy Day Society;Pop;1966;1975
Red Umbrella Club;New Wave;1982;1992
Rosalind Carrow;Jazz;1998;2024
Rufus Galloway;Blues;1959;1984
Saltwater Hymnal;Folk;2005;2024
Sadie Longacre;Country;1963;1982
Seven Mile Orchestra;Disco;1974;1981
Silas Pennyworth;Folk;1964;1988
Skylark Junction;Country;1987;2012
The Stovepipe Hats;Rock;1964;1970
Sugarloaf Cassidy;Rock;1972;1985
Tabitha Grange;Pop;1990;2009
Tangerine Ferry;Rock;1967;1974
Tin Roof Prophets;Blues;1985;2017
Tobias Ferrier;Singer-songwriter;2010;2024
Turnpike Sisters;Country;1978;1999
Ugly Ducklings Of York;Punk;1976;1982
Ulysses Grayson;Soul;1965;1983
The Umbrella Thieves;Rock;1983;1997
Uptown Lemonade;Disco;1977;1984
Valerie Storm;Pop;1981;1993
Vaudeville Ghosts;Rock;1994;2016
Velvet Custodians;Soul;1968;1980
Violet Rutherford;Jazz;1962;1989
Walter Pomeroy;Country;1953;1972
Weathervane;Folk;1972;1981
Whisky Cathedral;Metal;1979;1998
Wilhelmina Frost;Electronic;2001;2024
Winslow Parkway;Hip Hop;1990;2006
X Marks The Spotlight;New Wave;1981;1987
Xanthe Merrow;Electronic;2007;2024
Xavier Holloway;Jazz;1963;1992
Yarrow & Pine;Folk;2012;2024
Yesterday Machine;Rock;1996;2008
Yolanda Prewitt;Soul;1971;1989
Young Cartographers;Rock;2009;2023
Zachary Bloom;Pop;1986;2004
Zebra Crossing Choir;Pop;1970;1977
Zephyr Lodge;Rock;1971;1982
Zinnia Hart;Singer-songwriter;2006;2024
4 O'clock Ferry;Jazz;1985;2003
7 Crooked Miles;Rock;1990;2005
12th Street Regulars;Blues;1966;1987
19 Postcards;Pop;1984;1996
88 Candlesticks;Electronic;2000;2018
""",
    "nl": """
Aafke Zonneveld;Kleinkunst;1976;2009
Annelies De Wit;Levenslied;1969;1993
Het Avondcomité;Nederpop;1980;1990
Bakkersdochters;Nederpop;1981;1987
Bas Van Ommen;Singer-songwriter;2001;2024
Blauwbaard & Zn.;Nederpop;1978;1992
Café Tijdverdrijf;Kleinkunst;1988;2014
Cor Duinstra;Levenslied;1961;1989
Dijkbewaking;Rock;1983;2001
De Dorpspomp;Nederpop;1979;1994
Duo Zonder Haast;Kleinkunst;1995;2016
Eefje Marsman;Singer-songwriter;2006;2024
De Fietsenmakers;Nederpop;1977;1986
Fleur Oosterhuis;Pop;2010;2024
Gebroeders Klinkhamer;Rock;1974;1988
Geertje Wapstra;Folk;1971;1998
Gijs En De Golfbrekers;Rock;1965;1972
De Havenlichten;Nederpop;1982;1997
Hanneke Van Rossum;Kleinkunst;1967;1990
IJsbrand Kuiper;Singer-songwriter;1992;2019
Ineke En Haar Zwaluwen;Pop;1962;1969
Jelle Tuinstra;Folk;1984;2021
Jut Van Der Kade;Levenslied;1973;2002
Kees Lampe En Zijn Orkest;Dansorkest;1950;1967
Klein Orkest Van Zaterdag;Jazz;1972;1991
Lange Lijs;Rock;1970;1981
Lotte Brandsma;Pop;1998;2018
Maartje Hofland;Levenslied;1964;1985
Molenwiek;Folk;1974;1989
Noorderplein;Nederpop;1984;2006
De Nachtportiers;Nederpop;1981;2003
Onno Terpstra;Singer-songwriter;1979;2012
De Overloop;Rock;1991;2004
Perron Zeven;Nederpop;1986;1999
Pieternel Vos;Kleinkunst;1982;2008
Quirijn Smalbrugge;Singer-songwriter;1996;2020
Rieks Hamstra;Country;1977;1995
Roos Verhulst;Pop;2003;2023
Sluis 14;Nederpop;1980;1988
Sjoukje Algra;Folk;1990;2022
Tante Door;Levenslied;1958;1979
Tjerk Wierda;Folk;1975;2004
Tramlijn Acht;Nederpop;1983;1995
Uit De Pas;Punk;1978;1986
Vlinderjacht;Pop;1987;1996
Wim Zonderland;Kleinkunst;1955;1984
Xandra Bloemhof;Pop;1985;1997
Yvette Moerman;Levenslied;1983;2010
Zeemansgraf;Rock;1989;2011
Zusjes Van Loon;Pop;1957;1966
3 Losse Eindjes;Kleinkunst;1999;2017
""",
    "fr": """
Adèle Fontanel;Chanson;1958;1982
Les Amants Du Pont;Chanson;1963;1975
Bastien Roquefeuil;Chanson;1971;2003
Céleste Aubry;Pop;1984;2001
Élodie Marchand;Pop;1966;1978
Émile Castaing;Chanson;1950;1969
Fanfare De Minuit;Jazz;1994;2015
Gérard Lavigne;Chanson;1964;1991
Hélène Duvallon;Chanson;1976;2010
Les Jours Fériés;New Wave;1980;1988
Léonie Castel;Pop;2005;2024
Marcel Oriol Et Son Accordéon;Musette;1951;1968
Noé Fontenay;Singer-songwriter;2011;2024
Œil De Verre;Electronic;1998;2014
Quatuor Saint-amand;Classical;1979;2012
René Chassagne;Jazz;1956;1979
Sabine Delorme;Chanson;1968;1986
Théo Garrigue;Rock;1982;1999
Yves Montclar;Chanson;1954;1977
Zoé Barthélémy;Pop;1995;2019
""",
    "de": """
Annegret Sülzer;Schlager;1967;1989
Die Dachdecker;Rock;1981;1996
Egon Thalbach;Schlager;1959;1983
Fräulein Gestern;New Wave;1980;1986
Günther Aschenbrink;Jazz;1957;1981
Himmelblau & Söhne;Pop;1983;1998
Ingeborg Maiwald;Schlager;1961;1979
Jürgen Öhlmann;Singer-songwriter;1974;2006
Kammerorchester Lindental;Classical;1968;2005
Kühlschrank Eins;Electronic;1979;1994
Leuchtturm Nord;Rock;1993;2018
Lieselotte Grün;Schlager;1953;1974
Metronom Süd;Electronic;1976;1991
Die Nachtwächter;Rock;1972;1987
Paula Weißenfels;Pop;2002;2023
Straßenbahn Richtung Meer;New Wave;1982;1990
Ulrike Vogt;Folk;1973;1995
Viktor Brünninghaus;Classical;1962;1997
Zwölf Uhr Mittags;Rock;1985;2000
""",
    "sv": """
Åsa Bergvall;Folk;1977;2014
Birgitta Öström;Pop;1965;1983
Dalälvens Söner;Folk;1972;1991
Fjärilseffekten;Electronic;2003;2022
Göran Lindeskog;Singer-songwriter;1975;2009
Isbrytarna;Rock;1980;1997
Kråkans Orkester;Jazz;1969;1988
Linnéa Ekdahl;Pop;2004;2024
Mats Lindqvåg;Pop;1983;1999
Norrskenets Döttrar;Folk;1995;2020
Östra Hamnen;Rock;1990;2012
Vårflod;Rock;1976;1986
""",
    "da": """
Ærlige Anders;Singer-songwriter;1981;2005
Bjørn Halvorsen;Jazz;1964;1993
Dagny Sørlie;Folk;1978;2011
Frøken Regnvejr;Pop;1986;1998
Jørgen Kjærbye;Jazz;1961;1985
Karen Øllgaard;Pop;1994;2016
Nordlys Trio;Jazz;1999;2023
Ødegården;Folk;1973;1990
Søren Tvede;Singer-songwriter;1989;2021
Ukendt Passager;Rock;1982;2002
""",
}

# Titles by language. Every list is a pattern; braces name a word list below.
PATTERNS = {
    "en": [
        (6, "{adj} {noun}"),
        (3, "{noun} Of {stuff}"),
        (5, "{doing} {where}"),
        (4, "{head} {clause}"),
        (3, "Don't {act} {when}"),
        (1, "Last Train To {place}"),
        (1, "The Road To {place}"),
        (1, "A Postcard From {place}"),
        (1, "{place} In The Rain"),
        (1, "Back To {place}"),
        (1, "Goodbye, {place}"),
        (1, "Goodnight, {name}"),
        (1, "Dear {name}"),
        (1, "A Song For {name}"),
        (1, "{name} At The Window"),
        (1, "Waltz For {name}"),
        (2, "One More {single}"),
        (2, "Another {single}"),
        (1, "No More {many}"),
        (1, "Too Many {many}"),
        (2, "The {person}'s {thing}"),
        (1, "The {person} And The {noun}"),
        (3, "{phrase}"),
    ],
    "nl": [
        (5, "De {adj} {noun}"),
        (5, "{doing} {where}"),
        (4, "{head} {clause}"),
        (3, "Als {if}"),
        (1, "Terug Naar {place}"),
        (1, "Het Meisje Uit {place}"),
        (1, "Zondag In {place}"),
        (1, "Een Brief Uit {place}"),
        (1, "De Laatste Boot Naar {place}"),
        (1, "Dag {name}"),
        (1, "Lieve {name}"),
        (1, "{name} Aan Zee"),
        (1, "Wals Voor {name}"),
        (2, "Nog Een {single}"),
        (1, "Geen {many} Meer"),
        (4, "{phrase}"),
    ],
    "fr": [
        (7, "{thing} {of}"),
        (3, "{head} {clause}"),
        (1, "Retour À {place}"),
        (1, "Une Nuit À {place}"),
        (1, "Adieu {name}"),
        (1, "Chanson Pour {name}"),
        (1, "La Valse De {name}"),
        (3, "{phrase}"),
    ],
    "de": [
        (7, "{thing} {of}"),
        (3, "{doing} {where}"),
        (3, "{head} {clause}"),
        (1, "Zurück Nach {place}"),
        (1, "Grüße Aus {place}"),
        (1, "Ein Lied Für {name}"),
        (1, "Gute Nacht, {name}"),
        (3, "{phrase}"),
    ],
    "sv": [
        (8, "{thing} {of}"),
        (1, "Tillbaka Till {place}"),
        (1, "Brev Från {place}"),
        (1, "Visa Till {name}"),
        (4, "{phrase}"),
    ],
    "da": [
        (8, "{thing} {of}"),
        (1, "Tilbage Til {place}"),
        (1, "Brev Fra {place}"),
        (1, "Sang Til {name}"),
        (4, "{phrase}"),
    ],
    "classical": [
        (3, "{form} No. {number} In {key}: {movement}"),
        (2, "{form} In {key}, Op. {opus}"),
        (2, "Suite For {players}: {dance}"),
        (1, "{players} And Piano: {movement}"),
        (1, "Prelude And Fugue No. {number} In {key}"),
    ],
    "jazz": [
        (2, "Blues For {name}"),
        (1, "{place} Stomp"),
        (1, "{place} After Dark"),
        (2, "{name}'s Mood"),
        (1, "Taking The {ride} To {place}"),
        (1, "{number} Bars For {name}"),
        (2, "{swing}"),
        (2, "{adj} {noun}"),
        (1, "{doing} {where}"),
    ],
}

WORDS = {
    "en": {
        "adj": """Silver|Broken|Golden|Lonely|Crooked|Paper|Velvet|Crystal|Restless|Hollow|Electric|Distant|Faded|Gentle
            |Frozen|Burning|Northern|Secret|Quiet|Scarlet|Wooden|Second-hand|Borrowed|Empty|Painted|Tangled|Sleepless
            |Tender|Bitter|Weary|Copper|Runaway|Hand-me-down|Moonlit|Patient|Stubborn|Unwritten|Forgotten|Careless""",
        "noun": """River|Heart|Highway|Moon|Window|Garden|Shadow|Letter|Mirror|Fire|Ocean|Bridge|Station|Morning|Dream
            |Carousel|Piano|Lantern|Radio|Harbour|Mountain|Feather|Ballroom|Avenue|Stranger|Sailor|Angel|Promise
            |Memory|Ticket|Season|Horizon|Photograph|Kingdom|Orchard|Compass|Sparrow|Jukebox|Parade|Lullaby""",
        "stuff": "Gold|Glass|Mercy|Sorrow|Stone|Silence|Dust|Light|Yesterday|Roses|Tears|Smoke|Salt|Plenty|Snow|Thunder",
        "doing": """Dancing|Walking|Waiting|Dreaming|Driving|Drifting|Singing|Running|Crying|Laughing|Whistling|Whispering
            |Counting Stars|Killing Time|Falling Asleep|Missing You|Talking|Getting Lost""",
        "where": """In The Rain|On The Pier|Under The Bridge|By The River|Through The Night|Till The Morning|On A Monday
            |Without You|Along The Shore|Past Midnight|At The Edge Of Town|In The Kitchen|With The Lights Off
            |On The Night Bus|All The Way Home|Beneath The Willow|In Somebody's Car|At The Laundromat""",
        "head": "Tell Me|Nobody Knows|I Don't Care|Ask Me|Remember|I Wonder|Don't Forget|Show Me|She Knows",
        "clause": """Where You've Been|What You See|How It Ends|When It's Over|Why The Rain Falls|Who You Are|What I Said
            |How The Story Goes|Where The Money Went|Which Way The Wind Blows|What The Neighbours Say
            |How Far It Is|Where Tomorrow Hides|Why I Stayed""",
        "act": """Let Go|Look Back|Turn Around|Walk Away|Say Goodbye|Close Your Eyes|Break My Heart|Come Knocking
            |Wake The Neighbours|Call My Name|Hang Up|Read My Letters|Miss The Boat|Sell The House""",
        "when": "||Tonight|Again|Too Soon|Just Yet|This Time|Anymore|Before Morning|On My Account",
        "place": """Lisbon|Aberdeen|Memphis|Trieste|Tallinn|Whitby|Savannah|Galway|Winnipeg|Inverness|Dover|Tangier|Cardiff
            |Reykjavik|Baton Rouge|Havana|Brighton|Montreal|Valparaiso|Rotterdam|Tucson|Penzance""",
        "name": """Adelaide|Clementine|Rosie|Eleanor|Josie|Marianne|Billie|Louisa|Imogen|Frances|Dolores|Theodore|Annabel
            |Sylvie|Mabel|Harriet|Joan|Ramona|Edith|Delphine|Lucinda|Otis|Nell""",
        "single": """Cup Of Coffee|Mile|Sunday Morning|Reason To Stay|Dance|Rainy Day|Cigarette|Winter|Lonely Saturday
            |Chance|Song Before I Go|Round|Night In The City|Small Goodbye|Year Of This""",
        "many": "Heartaches|Promises|Rainy Mondays|Goodbyes|Cooks|Telephones|Miles|Broken Strings|Questions|Stairs|Cowboys",
        "person": "Sailor|Gambler|Preacher|Baker|Captain|Stranger|Widow|Milkman|Gardener|Piano Tuner|Watchmaker|Lodger",
        "thing": "Daughter|Lament|Return|Tale|Prayer|Hands|Holiday|Waltz|Overcoat|Last Ride|Lullaby|Diary",
        "phrase": """It Was Never About The Money|Half Past Lonely|Somewhere West Of Nowhere|Yours, Sincerely
            |Every Clock In This House|You Had Me At The Bus Stop|Leave The Porch Light On|Same Time Next Year
            |Nothing But The Weather|The Morning After The Fair|I'll Be Your Umbrella|A Little Less Than Heaven
            |Mind The Gap|Good Intentions|Somebody Else's Summer|What A Way To Go|My Side Of The Bed
            |Everything You Left Behind|Two Hearts & A Suitcase|99% Of The Time|Are You Lonesome, Too?
            |Let's Pretend It's June|Hey, Mister Postman's Son|Home By Seven|Not In This Town|All Roads Lead Out
            |Before The Circus Leaves|The Whole Of The Sky|Keep The Change|Wrong Side Of The River|Carry Me Over
            |If I Were A Carpenter's Wife|Love Is A Rented Room|Late For The Party|Ordinary Miracles|Honey, I'm Gone""",
    },
    "nl": {
        "adj": """Laatste|Eerste|Stille|Verre|Oude|Lege|Blauwe|Gouden|Lange|Kleine|Verloren|Koude|Vergeten|Gebroken|Scheve
            |Witte|Nieuwe|Warme""",
        "noun": """Trein|Zomer|Haven|Stad|Brief|Droom|Kade|Nacht|Straat|Klok|Zee|Molen|Vogel|Kermis|Brug|Winter|Kamer|Tuin
            |Dans|Reis|Boot|Foto|Liefde|Jas""",
        "doing": """Dansen|Lopen|Wachten|Dromen|Slapen|Zingen|Varen|Fietsen|Zwerven|Zwijgen|Lachen|Verdwalen|Thuiskomen
            |Koffiedrinken""",
        "where": """In De Regen|Langs De Gracht|Onder De Sterren|Tot De Ochtend|Aan Zee|Zonder Jou|Door De Stad|Op De Dijk
            |Bij Het Vuur|In Jouw Straat|Na Middernacht|Met De Ramen Open|Achter De Duinen|Op Zondag""",
        "head": "Niemand Weet|Vertel Mij|Vraag Niet|Zeg Me|Ik Vergeet|Weet Jij|Ik Raad",
        "clause": """Waar Je Bent|Hoe Het Was|Wat Je Ziet|Wie Je Bent|Waarom Je Huilt|Wanneer Je Komt|Wat De Zee Zegt
            |Hoe Laat Het Is|Waar De Trein Heen Gaat|Wat De Buren Denken""",
        "if": """De Zomer Komt|Jij Lacht|Het Regent In Mei|De Lichten Doven|Ik Later Groot Ben|De Boten Weer Gaan
            |Niemand Kijkt|Het Water Stijgt|De Kastanjes Bloeien|Alles Stilstaat|Jij De Deur Dichtdoet|Morgen Niet Komt
            |De Kermis Weg Is|Wij Oud Zijn""",
        "place": """Harlingen|Zutphen|Delft|Breskens|Terschelling|Maastricht|Groningen|Deventer|Oostende|Vlissingen
            |Appingedam|Kampen|Den Helder|Urk|Antwerpen|Hindeloopen""",
        "name": "Marijke|Hendrik|Annemoon|Liesbeth|Johanna|Willemijn|Teun|Saskia|Fietje|Dirk|Margriet|Tineke|Roosmarijn|Bram",
        "single": "Rondje|Kop Koffie|Zomer|Dansje|Keer Dan|Nacht|Liedje|Winter Met Jou|Halte|Pilsje|Wals",
        "many": "Tranen|Brieven|Maandagen|Beloftes|Sterren|Excuses|Haast|Regen|Zorgen",
        "phrase": """Het Is Weer Vrijdag|Brood Op De Plank|Twee Voor Twaalf|Niet Voor Vandaag|Zwart Op Wit|Mijn Kant Van De Stad
            |Alles Komt Goed|Een Huis Met Een Trap|Voor Je 't Weet|Kleine Wereld|Het Water Tot De Lippen|Onder Ons
            |Wie Het Laatst Lacht|De Groeten Aan Je Moeder|Half Om Half|Morgen Misschien|Zo Gaat Dat Hier
            |Tussen Kerk En Kroeg|Uit Het Oog|Laat De Lamp Maar Aan|Geen Bericht|De Buurt Slaapt Nog""",
    },
    "fr": {
        "thing": """La Pluie|La Mer|La Nuit|La Chanson|La Lettre|La Rue|La Fenêtre|La Gare|La Maison|Le Vent|Le Jardin|Le Train
            |Le Bal|Le Soleil|Le Printemps|Le Café|Le Voyage|Le Miroir|L'Hiver|L'Orage""",
        "of": """De Minuit|De L'Été|Du Dimanche|Sans Retour|De Mon Père|Des Amants|Du Port|De La Côte|D'Autrefois|En Novembre
            |À Deux Voix|De Personne""",
        "head": "Dis-moi|Je Sais|Tu Verras|Qui Sait|J'Ai Oublié|Demande-moi",
        "clause": "Où Tu Vas|Pourquoi Tu Pleures|Comment Ça Finit|Ce Qu'On Devient|Quand Viendra L'Été|Où Sont Les Fleurs|À Quoi Tu Rêves",
        "place": "Étretat|Marseille|Honfleur|Bruges|Lausanne|Nîmes|Saint-malo|Liège|Montréal|Besançon",
        "name": "Mathilde|Solène|Agnès|Jules|Noémie|Éloïse|Lucien|Irène|Colette|Gaspard",
        "phrase": """À Demain|Ça Ne Fait Rien|Tout S'En Va|Encore Un Peu|Comme Avant|Rien Que Pour Toi|Il Pleut Sur La Ville
            |Les Enfants Du Quai|Trois Fois Rien|Le Cœur Léger|C'Était Hier|Sous Les Platanes|Et Puis La Neige|Mon Île
            |Les Feuilles De Papier|Tu Reviendras""",
    },
    "de": {
        "thing": """Die Straße|Die Brücke|Die Stadt|Der Himmel|Der Garten|Der Zug|Das Fenster|Das Lied|Die Nacht|Der Träumer
            |Die Tänzerin|Das Karussell|Der Spiegel|Das Mädchen|Der Sommer|Die Tür""",
        "of": """Am Meer|Im Regen|Ohne Namen|Aus Glas|Nach Mitternacht|Von Gestern|Der Stille|Des Südens|Hinter Den Bergen
            |Im November|Ohne Wiederkehr|Über Der Stadt""",
        "doing": "Tanzen|Warten|Träumen|Schweigen|Spazieren|Heimkehren|Lachen|Verloren",
        "where": "Im Regen|Ohne Dich|Bis Zum Morgen|Am Hafen|Unter Den Linden|In Der Straßenbahn|Bei Kerzenschein|Im Schnee",
        "head": "Sag Mir|Niemand Weiß|Frag Nicht|Ich Weiß|Erzähl Mir",
        "clause": "Wo Du Warst|Wie Es War|Was Du Träumst|Wer Du Bist|Warum Du Gehst|Wann Der Frühling Kommt|Was Die Leute Sagen",
        "place": "Köln|Lübeck|Würzburg|Triest|Görlitz|Zürich|Düsseldorf|Bremen|Königswinter|Wien",
        "name": "Käthe|Lisbeth|Jörg|Annemarie|Gisela|Björn|Rosamunde|Ännchen|Lili|Konrad",
        "phrase": """Morgen Früh|Alles Auf Anfang|Ein Bißchen Glück|Du Und Dein Fahrrad|Kein Wort Mehr|Zum Letzten Mal|Heimweh
            |Immer Wieder Sonntags Um Drei|Tausend Kleine Lichter|Schöne Grüße|Fünf Vor Zwölf|Über Nacht|Großes Kino
            |Nie Wieder Allein|Wer Hätte Das Gedacht|Lichterloh""",
    },
    "sv": {
        "thing": "Sommaren|Natten|Regnet|Havet|Vägen|Tåget|Staden|Ljuset|Vinden|Brevet|Huset|Sången|Vintern|Flickan",
        "of": """Över Bron|I Norr|Utan Dig|Vid Ån|Efter Midnatt|På Andra Sidan|Bortom Bergen|Som Aldrig Tog Slut|Före Gryningen
            |Under Isen|I Mitt Hjärta""",
        "place": "Malmö|Göteborg|Växjö|Umeå|Åbo|Österlen|Härnösand",
        "name": "Märta|Sigrid|Åke|Elsa|Gösta|Ingrid|Björn",
        "phrase": """Midnattssol|Än En Gång|Håll Min Hand|Två Mil Hem|Nästan Vår|Så Nära|Inget Särskilt|Kom Som Du Är|Fågel I Storm
            |Blå Timmen|Sista Båten|Tystnaden Efter|Då Och Nu|Måndag Igen""",
    },
    "da": {
        "thing": "Sommeren|Natten|Regnen|Havet|Vejen|Toget|Byen|Lyset|Vinden|Brevet|Huset|Sangen|Vinteren|Pigen",
        "of": """Over Broen|I Nord|Uden Dig|Ved Åen|Efter Midnat|På Den Anden Side|Bag Bakkerne|Før Daggry|Under Isen
            |I Mit Hjerte|Der Aldrig Sluttede""",
        "place": "Ærø|Århus|Tromsø|Skagen|Rødby|Ålesund|Bornholm",
        "name": "Søren|Åse|Kirsten|Bjørn|Ingeborg|Mærthe|Grethe",
        "phrase": """Lige Nu|Én Gang Til|Hold Min Hånd|To Mil Hjem|Næsten Forår|Så Tæt På|Ikke Noget Særligt|Den Sidste Færge
            |Blå Time|Stilheden Bagefter|Dengang Og Nu|Mandag Igen|Rødt Løv|Østenvind""",
    },
    "classical": {
        "form": "Nocturne|Sonata|String Quartet|Piano Trio|Serenade|Impromptu|Partita|Concerto|Rhapsody|Elegy",
        "number": "1|2|3|4|5|6|7|8",
        "key": "C Major|D Minor|E Flat Major|F Sharp Minor|G Major|A Minor|B Flat Major|C Sharp Minor|A Flat Major|E Minor",
        "movement": "Allegro|Andante|Adagio|Scherzo|Rondo|Largo|Presto|Allegretto|Andante Con Moto|Vivace",
        "opus": "3|7|11|14|18|22|27|31|36|40|52",
        "players": "Strings|Wind Quintet|Violin|Cello|Flute And Harp|Clarinet|Oboe|Viola",
        "dance": "Prelude|Sarabande|Gigue|Minuet|Gavotte|Courante|Allemande|Bourrée",
    },
    "jazz": {
        "number": "Six|Eight|Twelve|Sixteen|Twenty-four",
        "ride": "Ferry|Night Bus|Slow Train|Scenic Route|Last Tram",
        "swing": """Tiptoe Shuffle|Sideways Waltz|Five Flights Up|Doorman's Delight|Rubber Soles|Afternoon Of A Clarinet
            |Low Ceiling|Minor Inconvenience|Flat Tyre Bounce|Ice In The Glass|The Long Intermission|Elevator Going Down
            |Brushes And Brandy|One For The Cloakroom|Slightly Out Of Town|Bar Tab|Counterclockwise|Hatcheck Girl""",
    },
}

# Album titles by language; {artist} makes a title that no other artist can have.
ALBUMS = {
    "en": """Letters From {place}|{adj} {noun}s|Live In {place}|The {place} Sessions|Songs For {name}|{doing} {where}|{phrase}
        |{head} {clause}|{noun}s Of {stuff}|Songs From A {adj} Room|The {person}'s {thing}|{adj} {noun}s, {adj2} {noun2}s
        |Too Many {many}|Music For {many}""",
    "nl": """Brieven Uit {place}|De {adj} {noun}|Live In {place}|{doing} {where}|{phrase}|Liedjes Voor {name}|{head} {clause}
        |Als {if}|Tussen {place} En {place2}|Ergens Bij {place}""",
    "fr": "{thing} {of}|{phrase}|Chansons Pour {name}|En Concert À {place}|Cartes Postales De {place}|{head} {clause}",
    "de": "{thing} {of}|{phrase}|Lieder Für {name}|Live In {place}|Briefe Aus {place}|{doing} {where}",
    "sv": "{thing} {of}|{phrase}|Visor Från {place}|Live I {place}",
    "da": "{thing} {of}|{phrase}|Sange Fra {place}|Live I {place}",
    "classical": "{form}s And {form2}s|The {form}s|Chamber Music With {players}|{form}s For {players}|An Evening Of {form}s",
    "jazz": "{swing}|{name}'s Mood|{place} After Dark|Live At The {noun} Club, {place}|{number} Bars For {name}|The {place} Concert",
}

# Compilations: title, genres it draws from (empty: any), languages (empty: any), first and last year.
COMPILATIONS = """
Jukebox Saturday: The Fifties;;en;1950;1959
Coffee Bar Favourites;Pop,Jazz;;1952;1964
Teenage Transistor;Pop,Rock;en;1959;1967
Beat Cellar Classics;Rock,Pop;en;1963;1969
Flower Market: Songs From The Late Sixties;Pop,Folk,Rock;;1966;1970
Long Hair, Longer Solos;Rock;;1968;1978
Smoke Signals: Southern & Swampy;Blues,Rock,Country;en;1965;1985
The Soul Kitchen Menu;Soul;;1962;1984
Mirrorball Memories;Disco,Soul;;1974;1984
Safety Pins & Sticky Floors;Punk,New Wave;;1976;1986
Raincoats And Synthesizers;New Wave,Electronic;;1979;1990
Neon Evenings;New Wave,Pop,Electronic;;1981;1989
Big Shoulders: Hits Of The Eighties;;en;1980;1989
Mixtape For The Motorway;Rock,Pop;;1978;1999
Flannel & Feedback;Rock;en;1989;1999
The Quiet Corner;Singer-songwriter,Folk;;1970;2024
Campfire Companions;Folk,Country;;1964;2010
Boots, Buckles & Broken Hearts;Country;en;1955;2012
Front Porch Radio;Country,Folk,Blues;en;1953;1990
Blues At The Crossing;Blues;;1950;1987
Jazz For A Rainy Window;Jazz;;1951;1979
After Hours At The Blue Tram;Jazz,Soul;;1955;1990
Brushes, Brass & Bass;Jazz;;1956;2010
Slow Clouds: Ambient Hours;Ambient,Electronic;;1994;2022
Circuits And Sunsets;Electronic;;1976;2020
Heavy Weather;Metal,Rock;;1979;2005
Island Time;Reggae,Soul;en;1973;1995
Chansons Du Dimanche;Chanson,Pop,Musette;fr;1950;1990
Paris S'Éveille Tard;Chanson,Pop,Jazz;fr;1954;2005
Bal Musette Et Petits Cafés;Musette,Chanson;fr;1950;1975
Schlagerparade: Die Goldenen Jahre;Schlager;de;1953;1983
Neue Töne Aus Der Nachbarschaft;New Wave,Rock,Pop,Electronic;de;1976;1998
Nordiska Kvällar;;sv,da;1964;2015
Midsommar På Radion;Folk,Pop;sv,da;1965;2010
Nederpop Uit De Oude Doos;Nederpop;nl;1977;1995
Radio Zeedijk: 40 Jaar Liedjes;;nl;1960;2000
Tranen Met Tuiten;Levenslied;nl;1958;2005
Kleinkunst Op Zondag;Kleinkunst,Singer-songwriter;nl;1955;2015
Uit De Polder: Folk Van Eigen Bodem;Folk;nl;1971;2015
Dansorkesten Uit Grootmoeders Tijd;Dansorkest,Pop,Levenslied;nl;1950;1969
Zomeravonden Aan Zee;Pop,Nederpop;nl,en;1979;2005
Vrijdagmiddagborrel;Nederpop,Rock,Pop;;1975;2005
Een Kist Vol Kerstgedachten;;nl;1960;2020
Classics By Candlelight;Classical;;1950;2024
Strings, Keys And Quiet Rooms;Classical,Ambient;;1950;2024
New Horizons: Songs Of The New Century;;;2000;2010
Tomorrow's Old Favourites;;;2008;2024
Bedroom Recordings & Other Small Rooms;Singer-songwriter,Electronic,Folk;;2003;2024
Kitchen Disco;Disco,Pop,Soul;;1974;2010
Late Trains: Songs For The Way Home;;en;1970;2012
""" + "\n".join(
    f"{series} {year};;{languages};{year - 2};{year}"
    for series, languages, years in (
        ("The Sound Of", "en", (1967, 1972, 1978, 1984, 1989, 1994)),
        ("Zomerhits", "", (1983, 1986, 1991, 1998)),
        ("Hits Van Het Jaar", "", (1968, 1975, 1981, 1987)),
        ("Summer Nights", "en", (1985, 1999, 2006)),
    )
    for year in years
)
