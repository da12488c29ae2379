// The floor with its lines: large ones, and smaller ones of half their brightness.
const vec3 c_Colour = vec3(0.2);
const float c_AlphaFromBelow = 0.25;
const float c_AlphaFromAbove = 0.75;

// Tiled, it is a grid of lines.
uniform sampler2D t_Texture;
// Added to the level of its mipmaps.
uniform float u_LevelBias;

// In large tiles, and in small ones.
varying vec4 v_Tiles;
varying float v_CameraHeight;

void main()
{
	float lines = texture2D(t_Texture, v_Tiles.xy, u_LevelBias).r
		+ 0.5 * texture2D(t_Texture, v_Tiles.zw, u_LevelBias).r;
	gl_FragColor = vec4(c_Colour + lines, v_CameraHeight < 0.0 ? c_AlphaFromBelow : c_AlphaFromAbove);
}
