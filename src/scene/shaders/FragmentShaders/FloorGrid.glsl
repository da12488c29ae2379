// The floor with its lines: large ones, and smaller ones of half their brightness.

// Tiled, it is a grid of lines.
uniform sampler2D t_Texture;

// In large tiles, and in small ones.
varying vec4 v_Tiles;
varying float v_CameraHeight;

void main()
{
	float lines = texture2D(t_Texture, v_Tiles.xy).r + 0.5 * texture2D(t_Texture, v_Tiles.zw).r;
	gl_FragColor = Floor(lines, v_CameraHeight);
}
